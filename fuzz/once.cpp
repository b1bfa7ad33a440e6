// Runs a target over the files of a folder, each once.

#include <cstdint>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t *data, std::size_t size);

int main(int, char **arguments) {
    int count = 0;
    for (const auto &file : std::filesystem::directory_iterator{arguments[1]}) {
        std::fprintf(stderr, "%s\n", file.path().c_str());
        std::ifstream stream{file.path(), std::ios::binary};
        const std::string bytes{std::istreambuf_iterator<char>{stream}, {}};
        LLVMFuzzerTestOneInput(reinterpret_cast<const std::uint8_t *>(bytes.data()), bytes.size());
        ++count;
    }
    return count > 0 ? 0 : 1;
}
