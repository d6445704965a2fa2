// Qt's events become the library's event objects: Mac key and character codes, Mac modifier
// bits, global points and tick time stamps, in the shapes classic hosts expect.
#include "events/QtInputConversion.h"

#include "events/AppActivation.h"
#include "events/EventQueue.h"
#include "events/EventQueueHooks.h"
#include "events/KeyCodeTables.h"
#include "events/PostEvent.h"
#include "host/Replaceable.h"
#include "platform/KeyTables.h"

#include <Velmar/Diagnostics.h>
#include <Velmar/Events.h>
#include <Velmar/FeatureFlags.h>

#include <QCursor>
#include <QGuiApplication>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QWheelEvent>
#include <QWidget>

#include <cstdlib>

namespace Velmar {

using namespace Private;

namespace {

Replaceable<InputWindowHooks> gInputHooks;

Point cursorPosition()
{
    if (!qobject_cast<QGuiApplication*>(QCoreApplication::instance()))
        return Point{0, 0};
    const QPoint p = QCursor::pos();
    return Point{SInt16(p.y()), SInt16(p.x())};
}

Point toPoint(const QPointF& p)
{
    const QPoint q = p.toPoint();
    return Point{SInt16(q.y()), SInt16(q.x())};
}

struct EventKindRow {
    QEvent::Type type;
    UInt32 eventClass;
    UInt32 eventKind;
};

// Window events that carry nothing but their kind.
constexpr EventKindRow kWindowEvents[] = {
    {QEvent::Move, kEventClassVelmar, kEventVelmarMoved},
    {QEvent::Show, kEventClassWindow, kEventWindowShown},
    {QEvent::Hide, kEventClassWindow, kEventWindowHidden},
    {QEvent::Close, kEventClassVelmar, kEventVelmarCloseRequested},
};

UInt16 macButton(Qt::MouseButton button, bool dragged)
{
    switch (button) {
    case Qt::LeftButton: return 1;
    case Qt::RightButton: return 2;
    case Qt::MiddleButton: return 3;
    case Qt::XButton1: return 4;
    case Qt::XButton2: return 5;
    default: return dragged ? 1 : 0;
    }
}

bool dragWaiting()
{
    const EventTypeSpec dragged{kEventClassMouse, kEventMouseDragged};
    return gMainEventQueue.findFirstMatching(&dragged, 1) != nullptr;
}

// Keys that only modify others post nothing by themselves; Meta is posted.
bool isPureModifier(int key)
{
    return key == Qt::Key_CapsLock || key == Qt::Key_Control || key == Qt::Key_AltGr
        || key == Qt::Key_Shift || key == Qt::Key_Alt;
}

} // namespace

const InputWindowHooks& Private::inputWindowHooks()
{
    return gInputHooks.get();
}

InputWindowHooks Private::SetInputWindowHooks(const InputWindowHooks& hooks)
{
    return gInputHooks.set(hooks);
}

bool ConvertMouseEvent(QMouseEvent* e, EventRef item, const QWidget* widget)
{
    if (!e || !item || !VELMAR_CHECK_EVENT(item))
        return false;
    item->eventClass = kEventClassMouse;
    item->attributes = kEventAttributeUserEvent;
    const bool leftHeld = e->buttons() & Qt::LeftButton;
    switch (e->type()) {
    case QEvent::MouseButtonPress:
    case QEvent::MouseButtonDblClick: // a second mouse-down: hosts count clicks themselves
        item->eventKind = kEventMouseDown;
        break;
    case QEvent::MouseButtonRelease:
        item->eventKind = kEventMouseUp;
        break;
    case QEvent::MouseMove:
        // Plain moves are never posted; drags only when looper filtering asks for them.
        item->eventKind = kEventMouseMoved;
        if (!leftHeld || !EnableLooperFiltering(kFeatureFlagQuery))
            return false;
        item->eventKind = kEventMouseDragged;
        if (LegacyEventProcessing() && dragWaiting())
            return false;
        break;
    default:
        VELMAR_ASSERT(false, "false");
        return false;
    }
    ForgetInputSnapshot();
    item->mouseButton = macButton(e->button(), item->eventKind == kEventMouseDragged);
    const bool inside = !widget || widget->rect().contains(e->position().toPoint());
    item->windowPart = inside ? 3 : 0;
    item->modifiers = GetCurrentKeyModifiers();
    item->where = toPoint(e->globalPosition());
    return true;
}

bool Private::ConvertWheelEvent(QWheelEvent* e, EventQueueItem* item)
{
    const QPoint angle = e->angleDelta();
    const bool horizontal = std::abs(angle.x()) > std::abs(angle.y());
    const int delta = horizontal ? angle.x() : angle.y();
    // Whole notches of 120; anything less is still one step, downward for nothing at all.
    SInt32 steps = (delta / 8) / 15;
    if (steps == 0)
        steps = delta > 0 ? 1 : -1;
    item->eventClass = kEventClassMouse;
    item->eventKind = kEventMouseWheelMoved;
    item->attributes = kEventAttributeUserEvent;
    item->where = toPoint(e->globalPosition());
    const UInt16 axis = horizontal ? kEventMouseWheelAxisX : kEventMouseWheelAxisY;
    const UInt32 modifiers = GetCurrentKeyModifiers();
    SetEventParameter(item, kEventParamMouseWheelAxis, typeMouseWheelAxis, 2, &axis);
    SetEventParameter(item, kEventParamMouseWheelDelta, typeLongInteger, 4, &steps);
    SetEventParameter(item, kEventParamKeyModifiers, typeUInt32, 4, &modifiers);
    return true;
}

bool ConvertKeyEvent(QKeyEvent* e, EventRef item)
{
    if (!e || !item || !VELMAR_CHECK_EVENT(item))
        return false;
    item->eventClass = kEventClassKeyboard;
    item->attributes = kEventAttributeUserEvent;
    switch (e->type()) {
    case QEvent::KeyPress:
        item->eventKind = e->isAutoRepeat() ? kEventRawKeyRepeat : kEventRawKeyDown;
        break;
    case QEvent::KeyRelease:
        if (e->isAutoRepeat())
            return false;
        item->eventKind = kEventRawKeyUp;
        break;
    default:
        VELMAR_ASSERT(false, "false");
        return false;
    }
    if (isPureModifier(e->key()))
        return false;
    ForgetInputSnapshot();

    const UInt16 c = GetUTF16Char(e);
    MacKeyPair codes;
    if (!(c && !(e->modifiers() & Qt::KeypadModifier) && macKeyForCharacter(char16_t(c), &codes))) {
        int vk = Platform::virtualKeyIndexForQtKey(e->key());
        if (vk < 0)
            vk = e->key() < 256 ? e->key() : 0;
        codes = macKeyForVirtualKey(vk);
    }
    item->keyMessage = UInt32(codes.charCode) | (UInt32(codes.keyCode) << 8)
        | (e->nativeScanCode() << 16);
    item->keyCode = codes.keyCode;
    item->charCode = codes.charCode;
    item->textUnit = c;
    item->qtKey = UInt32(e->key());
    item->qtModifiers = UInt32(e->modifiers());
    item->modifiers = GetCurrentKeyModifiers();
    item->where = cursorPosition();
    return true;
}

namespace {

bool convertInto(AQtWindow* window, QEvent* e, EventRef item);

} // namespace

bool ConvertVelmarEvent(AQtWindow* window, QEvent* e, EventRef item)
{
    if (!item || !VELMAR_CHECK_EVENT(item))
        return false;
    const bool converted = convertInto(window, e, item);
    // A host may convert into an event it has queued: the queue files events by type.
    if (gMainEventQueue.contains(item))
        gMainEventQueue.reindex();
    return converted;
}

namespace {

bool convertInto(AQtWindow* window, QEvent* e, EventRef item)
{
    item->clear();
    item->when = TickCount();
    if (!e) {
        if (window)
            return false;
        item->where = cursorPosition();
        item->modifiers = GetCurrentKeyModifiers();
        return true;
    }
    item->window = window;
    const InputWindowHooks& hooks = gInputHooks.get();
    switch (e->type()) {
    case QEvent::MouseButtonPress:
    case QEvent::MouseButtonRelease:
    case QEvent::MouseButtonDblClick:
    case QEvent::MouseMove:
        return ConvertMouseEvent(static_cast<QMouseEvent*>(e), item,
                                 window && hooks.widget ? hooks.widget(window) : nullptr);
    case QEvent::KeyPress:
    case QEvent::KeyRelease:
        return ConvertKeyEvent(static_cast<QKeyEvent*>(e), item);
    case QEvent::Wheel:
        return ConvertWheelEvent(static_cast<QWheelEvent*>(e), item);
    case QEvent::Paint:
        if (!window)
            return false;
        item->eventClass = kEventClassWindow;
        item->eventKind = kEventWindowUpdate;
        return true;
    case QEvent::Resize: {
        const bool zoomed = window && hooks.isMinimizeMaximizeChange
            && hooks.isMinimizeMaximizeChange(window);
        item->eventClass = kEventClassVelmar;
        item->eventKind = zoomed ? kEventVelmarZoomed : kEventVelmarResized;
        return true;
    }
    case QEvent::WindowActivate:
    case QEvent::WindowDeactivate:
        item->eventClass = kEventClassWindow;
        item->eventKind = e->type() == QEvent::WindowActivate ? kEventWindowActivated
                                                              : kEventWindowDeactivated;
        item->where = cursorPosition();
        return true;
    case QEvent::ApplicationActivate:
    case QEvent::ApplicationDeactivate:
        return ConvertApplicationActivation(e, item);
    default:
        for (const EventKindRow& row : kWindowEvents) {
            if (row.type == e->type()) {
                item->eventClass = row.eventClass;
                item->eventKind = row.eventKind;
                return true;
            }
        }
        return false;
    }
}

} // namespace

} // namespace Velmar
