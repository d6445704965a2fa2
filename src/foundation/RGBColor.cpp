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

void RGBColor::set(const QColor& c)
{
    red = static_cast<unsigned short>(c.redF() * 65535.0);
    green = static_cast<unsigned short>(c.greenF() * 65535.0);
    blue = static_cast<unsigned short>(c.blueF() * 65535.0);
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
