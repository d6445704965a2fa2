// Interned fonts with their metrics and a cache of text widths, so that drawing and
// measuring the same text again costs a hash look-up instead of a second shaping.
#pragma once

#include <Velmar/QtGrafPort.h>

#include <QFontMetrics>
#include <QHash>

namespace Velmar::Private {

struct FontEntry {
    explicit FontEntry(const QFont& f, const QPaintDevice* device);

    QFont font;
    QFontMetrics metrics;
    int ascent;
    int height;
    bool italic;
    qreal pixelSize; // the Toolbox size the font was made for

    // The advance of `text`; short texts are remembered.
    int width(const QString& text);

private:
    QHash<QString, int> m_widths;
};

// The entry of the font the port draws with now (found again only when that font changed).
FontEntry& portFontEntry(QtGrafPort* port);

// The entry of any font, measured for `device` (null: the screen).
FontEntry& fontEntry(const QFont& font, const QPaintDevice* device);

} // namespace Velmar::Private
