// The global hilite state, colour-model conversions, InvertColor and the colour dialog.
#include <Velmar/HostCore.h>
#include <Velmar/HostEncoding.h>
#include <Velmar/QuickDraw.h>

#include "foundation/Conversions.h"
#include "quickdraw/GrafPortPrivate.h"

#include <QApplication>
#include <QColorDialog>
#include <QGuiApplication>
#include <QPalette>

namespace Velmar {

namespace {

struct HiliteState {
    QColor color;
    bool colorSet = false;
    unsigned char mode = 0;
};

HiliteState& hilite()
{
    static HiliteState sHilite;
    return sHilite;
}

QColor paletteHighlight()
{
    if (qobject_cast<QGuiApplication*>(QCoreApplication::instance()))
        return QGuiApplication::palette().color(QPalette::Active, QPalette::Highlight);
    return QColor(0x30, 0x8c, 0xc6);
}

UInt16 scaledFraction(qreal fraction)
{
    // Truncated and cut to 16 bits: a grey's hue of -1 ends up as 1.
    return static_cast<UInt16>(static_cast<int>(fraction * 65535.0));
}

// Hue and saturation are the HSV ones in both models, as the Toolbox callers expect; only the
// third component differs.
template <typename Model, typename Component, typename Fraction>
void fromRgb(const RGBColor* rgb, Model* out, Component Model::*third,
             Fraction (QColor::*thirdF)() const)
{
    if (!rgb || !out)
        return;
    const QColor c = static_cast<QColor>(*rgb);
    out->hue = scaledFraction(c.hueF());
    out->saturation = scaledFraction(c.saturationF());
    out->*third = scaledFraction((c.*thirdF)());
}

} // namespace

namespace Private {

QColor globalHiliteColor()
{
    HiliteState& state = hilite();
    if (!state.colorSet) {
        state.color = paletteHighlight();
        state.colorSet = true;
    }
    return state.color;
}

} // namespace Private

void Initialize()
{
    static bool sDone = false;
    if (sDone)
        return;
    sDone = true;
    hilite().color = paletteHighlight();
    hilite().colorSet = true;
}

void LMGetHiliteRGB(RGBColor* color)
{
    if (color)
        *color = RGBColor(Private::globalHiliteColor());
}

void LMSetHiliteRGB(const RGBColor* color)
{
    if (!color)
        return;
    hilite().color = static_cast<QColor>(*color);
    hilite().colorSet = true;
}

unsigned char LMGetHiliteMode()
{
    return hilite().mode;
}

void LMSetHiliteMode(unsigned char mode)
{
    hilite().mode = mode;
}

void HSV2RGB(const HSVColor* hsv, RGBColor* rgb)
{
    if (!hsv || !rgb)
        return;
    const QColor c = QColor::fromHsvF(hsv->hue / 65535.0f, hsv->saturation / 65535.0f,
                                      hsv->value / 65535.0f, 1.0f)
                         .toRgb();
    *rgb = RGBColor(c);
}

void RGB2HSV(const RGBColor* rgb, HSVColor* hsv)
{
    fromRgb(rgb, hsv, &HSVColor::value, &QColor::valueF);
}

void RGB2HSL(const RGBColor* rgb, HSLColor* hsl)
{
    fromRgb(rgb, hsl, &HSLColor::lightness, &QColor::lightnessF);
}

void InvertColor(RGBColor* color)
{
    if (!color)
        return;
    color->red = static_cast<unsigned short>(~color->red);
    color->green = static_cast<unsigned short>(~color->green);
    color->blue = static_cast<unsigned short>(~color->blue);
}

namespace {

QString promptText(const unsigned char* prompt)
{
    if (!prompt || prompt[0] == 0)
        return QString();
    unsigned short title[512];
    const SInt32 units = CurrentMacMBCSEncodingToUTF16(reinterpret_cast<const char*>(prompt + 1),
                                                       prompt[0], title, 512);
    return QString::fromUtf16(reinterpret_cast<const char16_t*>(title), qMin<SInt32>(units, 511));
}

// A scripted run answers instead of a user: "OK" keeps the starting colour, "Cancel" (or
// anything else) cancels, and a colour name such as "#3366cc" is chosen as that colour.
std::optional<unsigned char> askAutomation(const QString& title, const QColor& start,
                                           RGBColor* outColor)
{
    AutomationListener* listener = AutomationListenerManager::GetListener();
    if (!listener)
        return std::nullopt;
    const QString answer =
        listener->AnswerDialog(title, start.name(), QStringLiteral("OK|Cancel")).trimmed();
    QColor chosen;
    if (answer.compare(QLatin1String("OK"), Qt::CaseInsensitive) == 0 || answer == u'0')
        chosen = start;
    else if (QColor::isValidColorName(answer))
        chosen = QColor::fromString(answer);
    if (!chosen.isValid())
        return 0;
    *outColor = RGBColor(chosen);
    return 1;
}

} // namespace

unsigned char GetColor(Point /*where*/, const unsigned char* prompt, const RGBColor* inColor,
                       RGBColor* outColor)
{
    if (!outColor)
        return 0;
    const QColor start = inColor ? static_cast<QColor>(*inColor) : QColor(Qt::white);
    const QString title = promptText(prompt);
    if (std::optional<unsigned char> answer = askAutomation(title, start, outColor))
        return *answer;
    if (!qobject_cast<QApplication*>(QCoreApplication::instance()))
        return 0;
    QColorDialog dialog;
    if (inColor)
        dialog.setCurrentColor(start);
    if (!title.isEmpty())
        dialog.setWindowTitle(title);
    if (dialog.exec() != QDialog::Accepted)
        return 0;
    *outColor = RGBColor(dialog.selectedColor());
    return 1;
}

} // namespace Velmar
