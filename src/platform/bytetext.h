#pragma once

#include <QString>

#include <string>
#include <string_view>

/// Bytes to text and back without loss. Text is UTF-8; a byte 0xNN that is no part of a valid
/// sequence becomes the lone surrogate U+DCNN, which no valid sequence gives.
QString textFromBytes(std::string_view bytes);

/// The inverse. A lone surrogate that stands for no byte becomes U+FFFD, which only foreign text
/// (pasted, say) can hold.
std::string bytesFromText(QStringView text);
