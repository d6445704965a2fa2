// The font calls: IDs and names, the current port's font, size, face and text mode, and
// reading them back.
#include <Velmar/Diagnostics.h>
#include <Velmar/QDText.h>

#include "quickdraw/CurrentPort.h"
#include "quickdraw/FontSelection.h"
#include "quickdraw/FontTable.h"
#include "quickdraw/PortPainter.h"

#include <QFontDatabase>
#include <QGuiApplication>

#include <algorithm>
#include <cstring>

namespace Velmar {

using namespace Private;

namespace {

// `preferred` when its row has `family`, else the first row that has it.
SInt16 idOfFamily(const QString& family, SInt16 preferred)
{
    const FontRow* row = findFontRow(preferred);
    if (row && row->family.compare(family, Qt::CaseInsensitive) == 0)
        return preferred;
    const SInt16 id = fontIdByFamily(family);
    if (id < 0)
        VelmarLog(kLogQuickDraw, "getFontIDByQtName(): Unknown font requested");
    return id < 0 ? preferred : id;
}

// Applies one of the three font rules to the current port's font.
template <typename Rule> void changePortFont(const char* call, bool appFont, Rule rule)
{
    CurrentPort port(call);
    if (!port)
        return;
    QFont font = port->currentFont();
    font.setHintingPreference(QFont::PreferFullHinting);
    rule(font, portData(port)->text);
    port->setFont(font);
    port->appFontFlag = appFont ? 1 : 0;
}

// A port given explicitly: null logs the call's no-port line, a stale one asserts.
QtGrafPort* readablePort(GrafPtr port, const char* call)
{
    if (!port) {
        warnNoCurrentPort(call);
        return nullptr;
    }
    return VELMAR_CHECK_PORT(port, nullptr) ? port : nullptr;
}

} // namespace

void GetFNum(const unsigned char* name, SInt16* id)
{
    if (!id)
        return;
    const QString text =
        name ? QString::fromLatin1(reinterpret_cast<const char*>(name + 1), name[0]) : QString();
    const SInt16 found = fontIdByToolboxName(text);
    if (found < 0)
        VelmarLog(kLogQuickDraw, "getFontID(): Unknown font requested");
    *id = found < 0 ? SInt16(0) : found;
}

void GetFontName(SInt16 id, unsigned char* name)
{
    if (!name)
        return;
    const FontRow* row = fontRowById(id);
    const QByteArray bytes = row ? row->toolboxName.toLatin1() : QByteArray();
    const size_t n = std::min<size_t>(size_t(bytes.size()), 255);
    std::memcpy(name, bytes.constData(), n);
    name[n] = 0;
}

SInt16 GetAppFont()
{
    return idOfFamily(QGuiApplication::font().family(), applFont);
}

SInt16 GetSysFont()
{
    return idOfFamily(QFontDatabase::systemFont(QFontDatabase::GeneralFont).family(), systemFont);
}

void TextFont(SInt16 id)
{
    TextFont(id, true);
}

void TextFont(SInt16 id, bool appFont)
{
    changePortFont("TextFont", appFont, [&](QFont& font, PortTextState& text) {
        text.fontId = applyFontFamily(font, id, appFont);
    });
}

void TextSize(SInt16 size)
{
    TextSize(size, true);
}

void TextSize(SInt16 size, bool appFont)
{
    changePortFont("TextSize", appFont,
        [&](QFont& font, PortTextState&) { applyFontSize(font, size, appFont); });
    if (QtGrafPort* port = currentGrafPort())
        port->textSize = size;
}

void TextFace(SInt16 face)
{
    TextFace(face, true);
}

void TextFace(SInt16 face, bool appFont)
{
    changePortFont("TextFace", appFont, [&](QFont& font, PortTextState& text) {
        applyFontFace(font, face);
        text.face = UInt8(face);
    });
}

void TextMode(SInt16 mode)
{
    CurrentPort port("Velmar::TextMode");
    if (!port)
        return;
    port->textMode = mode;
    PortTextState& text = portData(port)->text;
    text.composition = compositionModeForPenMode(mode);
    text.opaque = mode == srcCopy;
}

QFont TxFontSizeFaceToQFont(SInt16 id, SInt16 size, SInt16 face, bool appFont)
{
    QFont font;
    font.setHintingPreference(QFont::PreferFullHinting);
    applyFontFamily(font, id, appFont);
    applyFontSize(font, size, appFont);
    applyFontFace(font, face);
    return font;
}

SInt16 GetTxFontFromQFont(const QFont& font)
{
    return idOfFamily(font.family(), applFont);
}

SInt16 GetTxSizeFromQFont(const QFont& font)
{
    if (font.pointSizeF() > 0)
        return SInt16(std::min(qRound(font.pointSizeF() / 0.75), int(INT16_MAX)));
    return SInt16(std::max(font.pixelSize(), 0));
}

SInt16 GetTxFaceFromQFont(const QFont& font)
{
    SInt16 face = normal;
    if (font.weight() >= QFont::Bold)
        face |= bold;
    if (font.italic())
        face |= italic;
    if (font.underline())
        face |= underline;
    if (font.styleStrategy() & QFont::PreferOutline)
        face |= outline;
    if (font.stretch() != QFont::AnyStretch && font.stretch() < QFont::Unstretched)
        face |= condense;
    return face;
}

SInt16 GetPortTextFont(GrafPtr port)
{
    QtGrafPort* p = readablePort(port, "GetPortTextFont");
    if (!p)
        return 0;
    const SInt16 id = portData(p)->text.fontId;
    return id >= 0 ? id : GetTxFontFromQFont(p->currentFont());
}

SInt16 GetPortTextSize(GrafPtr port)
{
    QtGrafPort* p = readablePort(port, "GetPortTextSize");
    return p ? p->textSize : SInt16(0);
}

Style GetPortTextFace(GrafPtr port)
{
    QtGrafPort* p = readablePort(port, "GetPortTextFace");
    if (!p)
        return normal;
    const SInt16 face = portData(p)->text.face;
    return Style(face >= 0 ? face : GetTxFaceFromQFont(p->currentFont()));
}

SInt16 GetPortTextMode(GrafPtr port)
{
    QtGrafPort* p = readablePort(port, "GetPortTextMode");
    return p ? p->textMode : SInt16(0);
}

} // namespace Velmar
