// Small Toolbox calls with no better home: the beep, the menu bar height, tick conversion.
#include <Velmar/TextUtils.h>

#include <Velmar/HostCore.h>

#include <QApplication>

#include <cmath>
#include <limits>

namespace Velmar {

void SysBeep(SInt16 /*duration: the platform beep has none*/)
{
    if (qobject_cast<QApplication*>(QCoreApplication::instance()))
        QApplication::beep();
}

SInt16 GetMBarHeight()
{
    const AScreenManOS* screens = AScreenManOS::Get();
    if (!screens)
        return 0;
    return screens->GetMenuBarHeight(screens->GetCurrentScreen());
}

SInt32 EventTimeToTicks(double seconds)
{
    const double ticks = std::trunc(seconds * 60.0);
    // Out-of-range and NaN times saturate instead of invoking undefined conversions.
    if (std::isnan(ticks))
        return 0;
    if (ticks >= double(std::numeric_limits<SInt32>::max()))
        return std::numeric_limits<SInt32>::max();
    if (ticks <= double(std::numeric_limits<SInt32>::min()))
        return std::numeric_limits<SInt32>::min();
    return static_cast<SInt32>(ticks);
}

} // namespace Velmar
