#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>

/// Where a format puts its bytes: a buffer that is handed on whenever it is full.
class ByteSink {
public:
    static constexpr std::size_t bufferSize = 65'536;

    ByteSink(const ByteSink &) = delete;
    ByteSink &operator=(const ByteSink &) = delete;
    virtual ~ByteSink() = default;

    void put(char byte) { put(std::string_view{&byte, 1}); }
    void put(std::string_view bytes) {
        if (bytes.size() > bufferSize - used_) {
            flush();
            if (bytes.size() > bufferSize) {
                take(bytes);
                return;
            }
        }
        bytes.copy(buffer_.get() + used_, bytes.size());
        used_ += bytes.size();
    }
    /// Hands on what the buffer holds.
    void flush() {
        take({buffer_.get(), used_});
        used_ = 0;
    }

protected:
    ByteSink() : buffer_{new char[bufferSize]} {}

    /// Gets the bytes in their order, in as few pieces as possible.
    virtual void take(std::string_view bytes) = 0;

private:
    std::unique_ptr<char[]> buffer_;
    std::size_t used_ = 0;
};

/// The bytes that `format(sink)` puts. For texts that are needed whole.
template <class Format>
std::string formatted(Format format) {
    class StringSink : public ByteSink {
    public:
        std::string bytes;

    protected:
        void take(std::string_view more) override { bytes += more; }
    };
    StringSink sink;
    format(sink);
    sink.flush();
    return std::move(sink.bytes);
}
