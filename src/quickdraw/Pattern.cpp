// Patterns as brushes: conversion from pattern bytes, the standard patterns, recolouring
// with the port's colours, and the pen-mode to composition-mode table.
#include <Velmar/QuickDraw.h>

#include "quickdraw/PortPainter.h"

#include <QBitmap>
#include <QPixmap>

#include <array>
#include <cstring>

namespace Velmar {

namespace Private {

namespace {

constexpr Pattern kBlack{{0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF}};
constexpr Pattern kWhite{{0x00, 0x00, 0x00, 0x00, 0x00, 0x00, 0x00, 0x00}};
constexpr Pattern kGray{{0x55, 0xAA, 0x55, 0xAA, 0x55, 0xAA, 0x55, 0xAA}};
constexpr Pattern kLightGray{{0x22, 0x88, 0x22, 0x88, 0x22, 0x88, 0x22, 0x88}};
constexpr Pattern kDarkGray{{0xDD, 0x77, 0xDD, 0x77, 0xDD, 0x77, 0xDD, 0x77}};

quint64 patternKey(const Pattern& p)
{
    quint64 key;
    std::memcpy(&key, p.pat, sizeof key);
    return key;
}

// Small round-robin caches: hosts cycle through a handful of patterns and colours.
template <typename Key, int N>
struct BrushCacheTable {
    struct Entry {
        Key key{};
        bool used = false;
        QBrush brush;
    };
    std::array<Entry, N> entries;
    int next = 0;

    const QBrush* find(const Key& key) const
    {
        for (const Entry& e : entries) {
            if (e.used && e.key == key)
                return &e.brush;
        }
        return nullptr;
    }
    const QBrush& insert(const Key& key, const QBrush& brush)
    {
        Entry& e = entries[next];
        next = (next + 1) % N;
        e.key = key;
        e.used = true;
        e.brush = brush;
        return e.brush;
    }
};

struct TextureKey {
    qint64 texture;
    QRgb ink;
    QRgb paper;
    bool operator==(const TextureKey&) const = default;
};

BrushCacheTable<quint64, 32>& patternCache()
{
    static BrushCacheTable<quint64, 32> sCache;
    return sCache;
}

BrushCacheTable<TextureKey, 32>& textureCache()
{
    static BrushCacheTable<TextureKey, 32> sCache;
    return sCache;
}

QBrush buildPatternBrush(const Pattern& pattern)
{
    if (std::memcmp(pattern.pat, kBlack.pat, 8) == 0)
        return QBrush(Qt::black);
    if (std::memcmp(pattern.pat, kWhite.pat, 8) == 0)
        return QBrush(Qt::white);
    // Inverted rows, bit 0 leftmost: this fixes the horizontal phase of every pattern.
    uchar inverted[8];
    for (int i = 0; i < 8; ++i)
        inverted[i] = static_cast<uchar>(~pattern.pat[i]);
    return QBrush(QBitmap::fromData(QSize(8, 8), inverted, QImage::Format_MonoLSB));
}

// Opaque paper: the texture painted in ink over a paper-filled pixmap.
QBrush paintTextureOnPaper(const QBrush& brush, const QColor& ink, const QColor& paper)
{
    const QPixmap texture = brush.texture();
    QPixmap pixmap(texture.size());
    pixmap.fill(paper);
    QBrush inked = brush;
    inked.setColor(ink);
    QPainter painter(&pixmap);
    painter.fillRect(pixmap.rect(), inked);
    painter.end();
    return QBrush(pixmap);
}

} // namespace

QBrush patternToBrush(const Pattern& pattern)
{
    const quint64 key = patternKey(pattern);
    if (const QBrush* cached = patternCache().find(key))
        return *cached;
    return patternCache().insert(key, buildPatternBrush(pattern));
}

QBrush recolourBrush(const QBrush& brush, const QColor& ink, const QColor& paper,
                     bool transparentPaper)
{
    switch (brush.style()) {
    case Qt::NoBrush:
    case Qt::SolidPattern: {
        const QColor c = brush.style() == Qt::NoBrush ? QColor(Qt::black) : brush.color();
        if (c == QColor(Qt::black))
            return QBrush(ink);
        if (c == QColor(Qt::white))
            return QBrush(paper);
        return QBrush(c);
    }
    case Qt::TexturePattern: {
        if (transparentPaper) {
            QBrush inked = brush;
            inked.setColor(ink);
            return inked;
        }
        const TextureKey key{brush.texture().cacheKey(), ink.rgba(), paper.rgba()};
        if (const QBrush* cached = textureCache().find(key))
            return *cached;
        return textureCache().insert(key, paintTextureOnPaper(brush, ink, paper));
    }
    default: {
        // Hatches and gradients keep their shape and take the ink.
        QBrush inked = brush;
        if (brush.style() < Qt::LinearGradientPattern)
            inked.setColor(ink);
        return inked;
    }
    }
}

namespace {

const QBrush& resolveCached(QtGrafPortPrivate::BrushCache& cache, UInt32 serial, const QBrush& source,
                            const QColor& ink, const QColor& paper, bool transparentPaper,
                            Qt::GlobalColor solidKey, const QColor& solidColor)
{
    const QRgb inkKey = ink.rgba();
    const QRgb paperKey = paper.rgba();
    cache.serial = serial;
    if (cache.valid && cache.ink == inkKey && cache.paper == paperKey
        && cache.transparentPaper == transparentPaper && cache.source == source)
        return cache.result;
    cache.source = source;
    cache.ink = inkKey;
    cache.paper = paperKey;
    cache.transparentPaper = transparentPaper;
    cache.valid = true;
    if (source.style() == Qt::SolidPattern && source.color() == QColor(solidKey))
        cache.result = QBrush(solidColor);
    else
        cache.result = recolourBrush(source, ink, paper, transparentPaper);
    return cache.result;
}

} // namespace

const QBrush& resolveFillBrush(QtGrafPort* port)
{
    const QColor ink = port->foreColor();
    return resolveCached(portData(port)->fillCache, portData(port)->inkSerial, port->currentBrush(), ink,
                         port->backColor, port->penMode == patOr, Qt::black, ink);
}

const QBrush& resolveBackgroundBrush(QtGrafPort* port)
{
    return resolveCached(portData(port)->backCache, portData(port)->inkSerial, port->currentBackground(),
                         port->foreColor(), port->backColor, false, Qt::white, port->backColor);
}

QBrush resolvedPatternBrush(QtGrafPort* port, const QBrush& pattern)
{
    const QColor ink = port->foreColor();
    if (pattern.style() == Qt::SolidPattern && pattern.color() == QColor(Qt::black))
        return QBrush(ink);
    return recolourBrush(pattern, ink, port->backColor, port->penMode == patOr);
}

QPainter::CompositionMode compositionModeForPenMode(SInt16 mode)
{
    switch (mode) {
    case srcXor:
    case patXor:
        // Deliberately not-source-XOR-destination.
        return QPainter::RasterOp_NotSourceXorDestination;
    case patBic:
        // Deliberately drawn behind the existing pixels.
        return QPainter::CompositionMode_DestinationOver;
    case subPin:
        return QPainter::CompositionMode_Exclusion;
    default:
        return QPainter::CompositionMode_SourceOver;
    }
}

} // namespace Private

using namespace Private;

// ---- PatPtr ---------------------------------------------------------------------------------

PatPtr::PatPtr(const Pattern* pattern)
    : m_brush(pattern ? new QBrush(patternToBrush(*pattern)) : nullptr)
{
}

PatPtr::PatPtr(const QBrush& brush) : m_brush(new QBrush(brush))
{
}

PatPtr::PatPtr(const PatPtr& other) : m_brush(other.m_brush ? new QBrush(*other.m_brush) : nullptr)
{
}

PatPtr& PatPtr::operator=(const PatPtr& other)
{
    if (this == &other)
        return *this;
    delete m_brush;
    m_brush = other.m_brush ? new QBrush(*other.m_brush) : nullptr;
    return *this;
}

PatPtr::~PatPtr()
{
    delete m_brush;
}

// ---- Standard patterns -----------------------------------------------------------------------

namespace {

enum StandardPattern { kPatBlack, kPatWhite, kPatGray, kPatLightGray, kPatDarkGray };

const PatPtr& standardPattern(StandardPattern which, Pattern* out)
{
    static const Pattern* const kBytes[] = {&kBlack, &kWhite, &kGray, &kLightGray, &kDarkGray};
    static const PatPtr sPatterns[] = {PatPtr(&kBlack), PatPtr(&kWhite), PatPtr(&kGray),
                                       PatPtr(&kLightGray), PatPtr(&kDarkGray)};
    if (out)
        *out = *kBytes[which];
    return sPatterns[which];
}

} // namespace

const PatPtr& GetQDGlobalsBlack(Pattern* pattern)
{
    return standardPattern(kPatBlack, pattern);
}

const PatPtr& GetQDGlobalsWhite(Pattern* pattern)
{
    return standardPattern(kPatWhite, pattern);
}

const PatPtr& GetQDGlobalsGray(Pattern* pattern)
{
    return standardPattern(kPatGray, pattern);
}

const PatPtr& GetQDGlobalsLightGray(Pattern* pattern)
{
    return standardPattern(kPatLightGray, pattern);
}

const PatPtr& GetQDGlobalsDarkGray(Pattern* pattern)
{
    return standardPattern(kPatDarkGray, pattern);
}

} // namespace Velmar
