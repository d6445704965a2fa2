// Bounds-checked big-endian reading of resource data. Every read says whether the bytes were
// there; a failed read leaves the reader failed, so a decoder checks once at the end.
#pragma once

#include <Velmar/MacTypes.h>

#include <QByteArray>

namespace Velmar::Classic {

class BigEndianReader {
public:
    explicit BigEndianReader(const QByteArray& data, qsizetype pos = 0)
        : m_data(data), m_pos(pos), m_ok(pos >= 0 && pos <= data.size()) {}

    bool ok() const { return m_ok; }
    qsizetype pos() const { return m_pos; }
    qsizetype remaining() const { return m_ok ? m_data.size() - m_pos : 0; }
    bool atEnd() const { return remaining() == 0; }
    bool has(qsizetype n) const { return m_ok && n >= 0 && n <= m_data.size() - m_pos; }

    UInt8 u8() { return UInt8(fetch(1)); }
    UInt16 u16() { return UInt16(fetch(2)); }
    UInt32 u32() { return UInt32(fetch(4)); }
    SInt8 s8() { return SInt8(u8()); }
    SInt16 s16() { return SInt16(u16()); }
    SInt32 s32() { return SInt32(u32()); }
    Rect rect()
    {
        Rect r;
        r.top = s16();
        r.left = s16();
        r.bottom = s16();
        r.right = s16();
        return r;
    }
    Point point()
    {
        Point p;
        p.v = s16();
        p.h = s16();
        return p;
    }
    QByteArray bytes(qsizetype n)
    {
        if (!has(n)) {
            m_ok = false;
            return {};
        }
        QByteArray out = m_data.mid(m_pos, n);
        m_pos += n;
        return out;
    }
    // A length byte and that many bytes.
    QByteArray pascal() { return bytes(u8()); }
    void skip(qsizetype n)
    {
        if (!has(n))
            m_ok = false;
        else
            m_pos += n;
    }
    // Moves to an even offset (the word alignment of resource templates and pictures).
    void alignWord()
    {
        if (m_ok && (m_pos & 1) && m_pos < m_data.size())
            ++m_pos;
    }
    void fail() { m_ok = false; }

private:
    quint64 fetch(int n)
    {
        if (!has(n)) {
            m_ok = false;
            m_pos = m_data.size();
            return 0;
        }
        quint64 v = 0;
        for (int i = 0; i < n; ++i)
            v = (v << 8) | UInt8(m_data[m_pos + i]);
        m_pos += n;
        return v;
    }

    const QByteArray& m_data;
    qsizetype m_pos;
    bool m_ok;
};

// Reads at a fixed offset without a reader; 0 past the end (callers check bounds first).
inline UInt32 beAt(const QByteArray& d, qsizetype pos, int n)
{
    UInt32 v = 0;
    for (int i = 0; i < n; ++i)
        v = (v << 8) | (pos + i < d.size() && pos + i >= 0 ? UInt8(d[pos + i]) : 0);
    return v;
}

inline void putBE(QByteArray& out, UInt32 value, int n)
{
    for (int i = n - 1; i >= 0; --i)
        out.append(char((value >> (8 * i)) & 0xFF));
}

} // namespace Velmar::Classic
