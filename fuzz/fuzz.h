#pragma once

#include <string_view>
#include <vector>

/// A target is a function of this namespace that makes its claims on an input; fuzz.cpp runs one.
namespace targets {}

/// Ends the process where a claim does not hold; a fuzzer keeps the input then.
void require(bool holds, const char *claim);

/// Nothing is kept that the input did not hold: each text is a part of the bytes, behind the one
/// before it.
void requireParts(const std::vector<std::string_view> &texts, std::string_view bytes);
