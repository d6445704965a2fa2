#include "inspector/Switches.h"

#include <Velmar/AQtWindow.h>

#include "events/EventWaiter.h"
#include "foundation/ApplicationPrivate.h"
#include "inspector/InspectorShortcut.h"
#include "inspector/PaintOutlines.h"

#include <QSettings>

namespace Velmar::Private::Inspector {

namespace {

// The shortcut's filter goes in when the switch first comes on.
void enableShortcut(bool on)
{
    setInspectorEnabled(on);
    if (on)
        installInspectorShortcut();
}

template <PaintOutline outline>
bool outlineOn()
{
    return paintOutlineOn(outline);
}

template <PaintOutline outline>
void setOutline(bool on)
{
    setPaintOutline(outline, on);
}

const Switch kSwitches[] = {
    {"Direct drawing", nullptr,
     "New windows paint straight to the screen inside paint events instead of keeping a "
     "back buffer (windows already open keep their mode).",
     AQtWindow::defaultDirectQtDrawing, AQtWindow::setDefaultDirectQtDrawing},
    {"Null events", nullptr,
     "Timed waits end with a null event when their time is up. Off, they wait until a real "
     "event comes.",
     VelmarEventWaiter::nullEventTimerEnabled, VelmarEventWaiter::setNullEventTimerEnabled},
    {"Outline update region", nullptr, "Red: what each paint was asked to repaint.",
     outlineOn<kOutlineUpdate>, setOutline<kOutlineUpdate>},
    {"Outline dirty area", nullptr,
     "Blue: the part of the back buffer drawn into since the last copy to the screen.",
     outlineOn<kOutlineDirty>, setOutline<kOutlineDirty>},
    {"Outline visible region", nullptr, "Green: the port's visible region.",
     outlineOn<kOutlineVisible>, setOutline<kOutlineVisible>},
    {"Outline clip region", nullptr, "Magenta: the port's clip region.",
     outlineOn<kOutlineClip>, setOutline<kOutlineClip>},
    {"copyBitsToScreen", "copyBitsToScreen",
     "Every CopyBits into a window port is flushed to the screen at once, as "
     "CopyBitsToScreen is. Stored in the settings.",
     inspectorCopyBitsToScreen, setInspectorCopyBitsToScreen},
    {"enabled", "enabled",
     "Ctrl+Alt+Shift+I on a library window opens and closes this inspector. Stored in the "
     "settings; off by default so that shipped applications never open it by accident.",
     inspectorEnabled, enableShortcut},
};

} // namespace

std::span<const Switch> switches()
{
    return kSwitches;
}

void applySwitch(const Switch& row, bool on)
{
    row.set(on);
    if (row.settingsKey) {
        QSettings settings{QLatin1String(kSettingsOrganization),
                           QLatin1String(kSettingsApplication)};
        settings.setValue(QLatin1String(row.settingsKey), on);
    }
}

} // namespace Velmar::Private::Inspector
