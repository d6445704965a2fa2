// The containers that carried a resource fork off the Mac: MacBinary I, II and III, and
// AppleSingle/AppleDouble. Each answers the fork's bytes, or nullopt when the data is not
// that container (or is one with no resource fork).
#pragma once

#include <QByteArray>
#include <QString>

#include <optional>

namespace Velmar::Classic::Wrappers {

// CRC-16/XMODEM (polynomial 0x1021, start 0), as MacBinary II stores over bytes 0-123.
quint16 crc16(const char* data, qsizetype size);

enum class Kind { None, MacBinary, AppleSingle, AppleDouble };
struct Unwrapped {
    Kind kind = Kind::None;
    QByteArray resourceFork;
    bool certain = true; // false for a MacBinary I header, known only by a few zero bytes
};

// Recognises the container by its header; None when it is none of them. A recognised
// container without a usable resource fork has an empty fork and a reason in *error.
std::optional<Unwrapped> unwrap(const QByteArray& file, QString* error);

} // namespace Velmar::Classic::Wrappers
