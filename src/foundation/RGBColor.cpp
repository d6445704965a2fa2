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

// The Toolbox helpers took channelF() * 65535, truncated. Qt 6 hands out channelF() in
// single precision, which would lose one step on half of the 16-bit values, so colours
// give their exact 16-bit channels instead (extended-range ones clamped by toRgb()).
void RGBColor::set(const QColor& c)
{
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
    // The same colour as setRgbF(channel / 65535.0f) gives for every 16-bit value (checked
    // exhaustively), without the float round trip.
    return QColor::fromRgba64(red, green, blue);
}

RGBColor::operator unsigned int() const
{
    return 0xFF000000u | narrow(red) << 16 | narrow(green) << 8 | narrow(blue);
}

} // namespace Velmar
