#include "classic/resfile/ForkWrappers.h"

#include "classic/resfile/BigEndian.h"

namespace Velmar::Classic::Wrappers {

namespace {

constexpr qsizetype kMacBinaryHeader = 128;
constexpr UInt32 kAppleSingleMagic = 0x00051600;
constexpr UInt32 kAppleDoubleMagic = 0x00051607;
constexpr UInt32 kResourceForkEntry = 2;

qint64 roundUp128(qint64 n)
{
    return (n + 127) & ~qint64(127);
}

// MacBinary: a 128-byte header, the data fork and the resource fork, each padded to 128.
// II and III carry a CRC of the first 124 header bytes; I is known only by its zero bytes.
std::optional<Unwrapped> macBinary(const QByteArray& file, QString* error)
{
    if (file.size() < kMacBinaryHeader)
        return std::nullopt;
    const UInt8 nameLength = UInt8(file[1]);
    if (file[0] != 0 || file[74] != 0 || nameLength < 1 || nameLength > 63)
        return std::nullopt;
    const bool crcMatches = beAt(file, 124, 2) == crc16(file.constData(), 124);
    if (!crcMatches && file[82] != 0)
        return std::nullopt;
    if (!crcMatches) {
        // MacBinary I leaves bytes 99-127 zero.
        for (int i = 99; i < kMacBinaryHeader; ++i) {
            if (file[i] != 0)
                return std::nullopt;
        }
    }
    const qint64 dataLength = beAt(file, 83, 4);
    const qint64 rsrcLength = beAt(file, 87, 4);
    const qint64 secondary = crcMatches ? beAt(file, 120, 2) : 0;
    const qint64 dataStart = kMacBinaryHeader + roundUp128(secondary);
    const qint64 rsrcStart = dataStart + roundUp128(dataLength);
    if (rsrcStart + rsrcLength > file.size()) {
        if (!crcMatches)
            return std::nullopt; // not MacBinary after all
        if (error)
            *error = QStringLiteral("MacBinary forks run past the end of the file");
        return Unwrapped{Kind::MacBinary, {}, true};
    }
    if (rsrcLength == 0) {
        if (error)
            *error = QStringLiteral("MacBinary file without a resource fork");
        return Unwrapped{Kind::MacBinary, {}, crcMatches};
    }
    return Unwrapped{Kind::MacBinary, file.mid(rsrcStart, rsrcLength), crcMatches};
}

// AppleSingle and AppleDouble: magic, version, 16 filler bytes, a count and entries of
// (ID, offset, length); entry 2 is the resource fork.
std::optional<Unwrapped> appleSingleOrDouble(const QByteArray& file, QString* error)
{
    if (file.size() < 26)
        return std::nullopt;
    const UInt32 magic = beAt(file, 0, 4);
    if (magic != kAppleSingleMagic && magic != kAppleDoubleMagic)
        return std::nullopt;
    const Kind kind = magic == kAppleSingleMagic ? Kind::AppleSingle : Kind::AppleDouble;
    const qint64 count = beAt(file, 24, 2);
    if (26 + count * 12 > file.size()) {
        if (error)
            *error = QStringLiteral("AppleSingle/AppleDouble entry table runs past the end of the file");
        return Unwrapped{kind, {}};
    }
    for (qint64 i = 0; i < count; ++i) {
        const qint64 at = 26 + i * 12;
        if (beAt(file, at, 4) != kResourceForkEntry)
            continue;
        const qint64 offset = beAt(file, at + 4, 4);
        const qint64 length = beAt(file, at + 8, 4);
        if (offset + length > file.size()) {
            if (error)
                *error = QStringLiteral("resource fork entry runs past the end of the file");
            return Unwrapped{kind, {}};
        }
        return Unwrapped{kind, file.mid(offset, length)};
    }
    if (error)
        *error = QStringLiteral("AppleSingle/AppleDouble file without a resource fork entry");
    return Unwrapped{kind, {}};
}

} // namespace

quint16 crc16(const char* data, qsizetype size)
{
    quint16 crc = 0;
    for (qsizetype i = 0; i < size; ++i) {
        crc ^= quint16(UInt8(data[i])) << 8;
        for (int bit = 0; bit < 8; ++bit)
            crc = (crc & 0x8000) ? quint16((crc << 1) ^ 0x1021) : quint16(crc << 1);
    }
    return crc;
}

std::optional<Unwrapped> unwrap(const QByteArray& file, QString* error)
{
    if (auto apple = appleSingleOrDouble(file, error))
        return apple;
    if (auto binary = macBinary(file, error))
        return binary;
    return Unwrapped{};
}

} // namespace Velmar::Classic::Wrappers
