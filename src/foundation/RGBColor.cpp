#include <Velmar/MacTypes.h>

#include <QColor>

namespace Velmar {

const float kChannelScale = 65535.0f / 255;

namespace {
unsigned short widen(int byte)
{
    return static_cast<unsigned short>(static_cast<float>(byte) * kChannelScale);
}
unsigned int narrow(unsigned short channel)
{
    return static_cast<unsigned int>(static_cast<float>(channel) / kChannelScale);
}
} // namespace

RGBColor::RGBColor(const QColor& c)
{
    set(c);
}

RGBColor::RGBColor(unsigned int argb)
{
    set(argb);
}

// channelF() * 65535 truncated, as the Toolbox helpers always did. Qt 6 hands out channelF()
// in single precision, which would lose one step on half of the 16-bit values, so ordinary
// colours take their exact 16-bit channels; only extended-range colours go through floats.
static unsigned short channelFromFloat(float f)
{
    const double v = static_cast<double>(f) * 65535.0;
    return v <= 0.0 ? 0 : v >= 65535.0 ? 65535 : static_cast<unsigned short>(v);
}

void RGBColor::set(const QColor& c)
{
    if (c.spec() == QColor::ExtendedRgb) {
        red = channelFromFloat(c.redF());
        green = channelFromFloat(c.greenF());
        blue = channelFromFloat(c.blueF());
        return;
    }
    if (!c.isValid()) {
        red = green = blue = 0;
        return;
    }
    const QRgba64 exact = c.toRgb().rgba64();
    red = exact.red();
    green = exact.green();
    blue = exact.blue();
}

void RGBColor::set(unsigned int argb)
{
    red = widen((argb >> 16) & 0xFF);
    green = widen((argb >> 8) & 0xFF);
    blue = widen(argb & 0xFF);
}

RGBColor::operator QColor() const
{
    QColor c;
    c.setRgbF(red / 65535.0f, green / 65535.0f, blue / 65535.0f, 1.0f);
    return c;
}

RGBColor::operator unsigned int() const
{
    return 0xFF000000u | narrow(red) << 16 | narrow(green) << 8 | narrow(blue);
}

} // namespace Velmar
