#include "quickdraw/FontCache.h"

#include "quickdraw/GrafPortPrivate.h"

#include <memory>

namespace Velmar::Private {

namespace {

// Texts longer than this are measured every time: they are rarely drawn twice.
constexpr qsizetype kLongestCachedText = 256;
constexpr qsizetype kMaxCachedWidths = 4096;
// Hosts use a handful of fonts; a program that makes new ones without end starts over here.
constexpr qsizetype kMaxFonts = 128;

struct FontKey {
    QFont font;
    int dpi;
    bool operator==(const FontKey& other) const { return dpi == other.dpi && font == other.font; }
};

size_t qHash(const FontKey& key, size_t seed = 0)
{
    return ::qHash(key.font, seed) ^ size_t(key.dpi);
}

struct Interned {
    QHash<FontKey, std::shared_ptr<FontEntry>> entries;
    // Ports hold plain pointers to entries; a new generation tells them to look again.
    UInt32 generation = 1;
};

Interned& interned()
{
    static Interned sInterned;
    return sInterned;
}

} // namespace

FontEntry::FontEntry(const QFont& f, const QPaintDevice* device)
    : font(f), metrics(device ? QFontMetrics(f, device) : QFontMetrics(f)),
      ascent(metrics.ascent()), height(metrics.height()), italic(f.italic()),
      pixelSize(f.pointSizeF() > 0 ? f.pointSizeF() / 0.75 : qreal(f.pixelSize()))
{}

int FontEntry::width(const QString& text)
{
    if (text.size() > kLongestCachedText)
        return metrics.horizontalAdvance(text);
    const auto it = m_widths.constFind(text);
    if (it != m_widths.constEnd())
        return it.value();
    if (m_widths.size() >= kMaxCachedWidths)
        m_widths.clear();
    const int w = metrics.horizontalAdvance(text);
    m_widths.insert(text, w);
    return w;
}

FontEntry& fontEntry(const QFont& font, const QPaintDevice* device)
{
    Interned& all = interned();
    const FontKey key{font, device ? device->logicalDpiY() : 0};
    auto it = all.entries.find(key);
    if (it != all.entries.end())
        return *it.value();
    if (all.entries.size() >= kMaxFonts) {
        all.entries.clear();
        ++all.generation;
    }
    auto entry = std::make_shared<FontEntry>(font, device);
    FontEntry& result = *entry;
    all.entries.insert(key, std::move(entry));
    return result;
}

FontEntry& portFontEntry(QtGrafPort* port)
{
    PortTextState& text = portData(port)->text;
    const QFont& current = port->currentFont();
    const UInt32 generation = interned().generation;
    // QFont compares by its shared data first, so an unchanged font costs a pointer compare.
    if (text.entry && text.entryGeneration == generation && text.entryFont == current)
        return *text.entry;
    const QPaintDevice* device = port->image();
    FontEntry& entry = fontEntry(current, device);
    text.entry = &entry;
    text.entryGeneration = interned().generation;
    text.entryFont = current;
    return entry;
}

} // namespace Velmar::Private
