// The default screen manager: Qt's screens, numbered in the order Qt lists them.
#include <Velmar/HostCore.h>

#include "host/Replaceable.h"

#include <QApplication>
#include <QGuiApplication>
#include <QMenuBar>
#include <QScreen>

namespace Velmar {

namespace {

bool haveGuiApplication()
{
    return qobject_cast<QGuiApplication*>(QCoreApplication::instance()) != nullptr;
}

QScreen* screenAt(SInt32 screen)
{
    if (!haveGuiApplication())
        return nullptr;
    const QList<QScreen*> screens = QGuiApplication::screens();
    return (screen >= 0 && screen < screens.size()) ? screens.at(screen) : nullptr;
}

// What a one-menu menu bar measures in the current style; needs a widget application.
SInt16 styledMenuBarHeight()
{
    QMenuBar probe;
    probe.addMenu(QStringLiteral("File"));
    return SInt16(probe.sizeHint().height());
}

} // namespace

AScreenManOS::~AScreenManOS() = default;

SInt32 AScreenManOS::GetCurrentScreen() const
{
    QScreen* primary = haveGuiApplication() ? QGuiApplication::primaryScreen() : nullptr;
    return primary ? SInt32(QGuiApplication::screens().indexOf(primary)) : -1;
}

SInt32 AScreenManOS::GetScreenCount() const
{
    return haveGuiApplication() ? SInt32(QGuiApplication::screens().size()) : 0;
}

SInt32 AScreenManOS::GetScreenForPoint(const QPoint& globalPoint) const
{
    const SInt32 count = GetScreenCount();
    SInt32 nearest = -1;
    qint64 nearestDistance = 0;
    for (SInt32 i = 0; i < count; ++i) {
        const QRect r = GetScreenRect(i);
        if (r.contains(globalPoint))
            return i;
        const qint64 dx = globalPoint.x() < r.left() ? r.left() - globalPoint.x()
                        : globalPoint.x() > r.right() ? globalPoint.x() - r.right() : 0;
        const qint64 dy = globalPoint.y() < r.top() ? r.top() - globalPoint.y()
                        : globalPoint.y() > r.bottom() ? globalPoint.y() - r.bottom() : 0;
        const qint64 distance = dx * dx + dy * dy;
        if (nearest < 0 || distance < nearestDistance) {
            nearest = i;
            nearestDistance = distance;
        }
    }
    return nearest;
}

SInt16 AScreenManOS::GetMenuBarHeight(SInt32 screen) const
{
    Q_UNUSED(screen); // the menu bar sits in the window here, the same on every screen
    static SInt16 measured = 0; // measured once a widget application exists
    if (measured > 0)
        return measured;
    if (!qobject_cast<QApplication*>(QCoreApplication::instance()))
        return 20; // the classic height, without a widget application to ask
    measured = styledMenuBarHeight();
    return measured;
}

QRect AScreenManOS::GetScreenRect(SInt32 screen) const
{
    QScreen* s = screenAt(screen);
    return s ? s->geometry() : QRect();
}

QRect AScreenManOS::GetUsableRect(SInt32 screen) const
{
    QScreen* s = screenAt(screen);
    return s ? s->availableGeometry() : QRect();
}

QRect AScreenManOS::GetUsableRectForPoint(const QPoint& globalPoint) const
{
    return GetUsableRect(GetScreenForPoint(globalPoint));
}

AScreenManOS* AScreenManOS::Get()
{
    return Private::replaceableInstance<AScreenManOS>().get();
}

AScreenManOS* AScreenManOS::SetInstance(AScreenManOS* manager)
{
    return Private::replaceableInstance<AScreenManOS>().set(manager);
}

} // namespace Velmar
