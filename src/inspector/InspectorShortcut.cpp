#include "inspector/InspectorShortcut.h"

#include <Velmar/Diagnostics.h>
#include <Velmar/Inspector.h>

#include "foundation/ApplicationPrivate.h"
#include "inspector/InspectorWindow.h"
#include "windows/WindowFilters.h"

#include <QApplication>
#include <QKeyEvent>

namespace Velmar::Private::Inspector {

namespace {

constexpr Qt::KeyboardModifiers kChord = Qt::ControlModifier | Qt::AltModifier | Qt::ShiftModifier;

bool onSpecialEvent(AQtWindow*, QEvent* e)
{
    if (e->type() != QEvent::KeyPress || !inspectorEnabled())
        return false;
    const auto* key = static_cast<QKeyEvent*>(e);
    if (key->key() != Qt::Key_I || (key->modifiers() & ~Qt::KeypadModifier) != kChord)
        return false;
    if (!key->isAutoRepeat())
        ToggleVelmarInspector();
    return true;
}

} // namespace

void installInspectorShortcut()
{
    WindowFilterHooks hooks = windowFilterHooks();
    if (hooks.specialEvent) // ours already, or a host's own, which stays
        return;
    hooks.specialEvent = onSpecialEvent;
    SetWindowFilterHooks(hooks);
}

} // namespace Velmar::Private::Inspector

namespace Velmar {

void ToggleVelmarInspector()
{
    if (!QApplication::instance()) {
        VelmarLog(kLogUnknown, "ToggleVelmarInspector: no application");
        return;
    }
    auto* inspector = Private::Inspector::InspectorWindow::instance(true);
    inspector->setVisible(!inspector->isVisible());
    if (inspector->isVisible())
        inspector->raise();
}

bool IsVelmarInspectorVisible()
{
    const auto* inspector = Private::Inspector::InspectorWindow::instance(false);
    return inspector && inspector->isVisible();
}

} // namespace Velmar
