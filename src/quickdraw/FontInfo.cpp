// FontInfo, GetFontInfo and the size of multi-line text.
#include <Velmar/Diagnostics.h>
#include <Velmar/QDText.h>
#include <Velmar/TextUtils.h>

#include "quickdraw/CurrentPort.h"

#include <QFontMetrics>
#include <QRegularExpression>

namespace Velmar {

using namespace Private;

FontInfo::FontInfo() : m_metrics(new QFontMetrics(QFont()))
{}

FontInfo::FontInfo(const QFont& font) : m_metrics(new QFontMetrics(font))
{}

FontInfo::FontInfo(const FontInfo& other) : m_metrics(new QFontMetrics(*other.m_metrics))
{}

FontInfo& FontInfo::operator=(const FontInfo& other)
{
    *m_metrics = *other.m_metrics;
    return *this;
}

FontInfo::~FontInfo()
{
    delete m_metrics;
}

void FontInfo::setFont(const QFont& font)
{
    *m_metrics = QFontMetrics(font);
}

int FontInfo::ascent() const
{
    return m_metrics->ascent();
}

int FontInfo::descent() const
{
    return m_metrics->descent();
}

int FontInfo::lineSpacing() const
{
    return m_metrics->lineSpacing();
}

int FontInfo::leading() const
{
    return m_metrics->leading();
}

int FontInfo::widMax() const
{
    const int widest = m_metrics->maxWidth();
    if (widest != 0)
        return widest;
    VelmarLog(kLogNotImpl, "Velmar::FontInfo::widMax");
    return m_metrics->horizontalAdvance(QLatin1Char('W'));
}

QString FontInfo::fitTextToWidth(const QString& text, int width, Qt::TextElideMode mode) const
{
    return m_metrics->elidedText(text, mode, width);
}

QSize FontInfo::CalculateTextRectSize(const char* text, int* lineCount, int flags) const
{
    return calculateTextRectSizeUTF16(MakeQString(text, -1), lineCount, flags);
}

QSize FontInfo::calculateTextRectSizeUTF16(const QString& text, int* lineCount, int flags) const
{
    // A pair counts as one break: the longer alternatives come first.
    static const QRegularExpression sBreaks(QStringLiteral("\r\n|\n\r|\r"));
    QString lines = text;
    lines.replace(sBreaks, QStringLiteral("\n"));
    if (lineCount)
        *lineCount = int(lines.count(QLatin1Char('\n'))) + 1;
    return m_metrics->size(flags, lines);
}

void GetFontInfo(FontInfo* info)
{
    CurrentPort port("GetFontInfo");
    if (!port || !info)
        return;
    info->setFont(port->currentFont());
}

} // namespace Velmar
