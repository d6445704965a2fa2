#include "inspector/InspectorNames.h"

#include <Velmar/Events.h>
#include <Velmar/Windows.h>

#include "foundation/NameTable.h"

namespace Velmar::Private::Inspector {

namespace {

constexpr NamedValue<UInt32> kWindowClasses[] = {
    {kAlertWindowClass, "alert"},
    {kMovableAlertWindowClass, "movable alert"},
    {kModalWindowClass, "modal"},
    {kMovableModalWindowClass, "movable modal"},
    {kFloatingWindowClass, "floating"},
    {kDocumentWindowClass, "document"},
    {kUtilityWindowClass, "utility"},
    {kHelpWindowClass, "help"},
    {kSheetWindowClass, "sheet"},
    {kToolbarWindowClass, "toolbar"},
    {kPlainWindowClass, "plain"},
    {kOverlayWindowClass, "overlay"},
    {kSheetAlertWindowClass, "sheet alert"},
    {kAltPlainWindowClass, "alt plain"},
};

constexpr NamedValue<UInt16> kEventCodes[] = {
    {nullEvent, "nullEvent"},
    {mouseDown, "mouseDown"},
    {mouseUp, "mouseUp"},
    {keyDown, "keyDown"},
    {keyUp, "keyUp"},
    {autoKey, "autoKey"},
    {updateEvt, "updateEvt"},
    {diskEvt, "diskEvt"},
    {activateEvt, "activateEvt"},
    {osEvt, "osEvt"},
    {kHighLevelEvent, "kHighLevelEvent"},
};

constexpr NamedValue<UInt32> kModifiers[] = {
    {activeFlag, "active"},
    {btnState, "btnState"},
    {cmdKey, "cmd"},
    {shiftKey, "shift"},
    {alphaLock, "alphaLock"},
    {optionKey, "option"},
    {controlKey, "control"},
    {rightShiftKey, "rightShift"},
    {rightOptionKey, "rightOption"},
};

// The marks of the system font that have names.
constexpr NamedValue<SInt16> kMarks[] = {
    {0x11, "commandMark"},
    {0x12, "checkMark"},
    {0x13, "diamondMark"},
    {0x14, "appleMark"},
};

} // namespace

QString windowClassName(UInt32 windowClass)
{
    if (const char* name = nameOf(kWindowClasses, windowClass, nullptr))
        return QLatin1String(name);
    return QStringLiteral("class %1").arg(windowClass);
}

QString eventCodeName(UInt16 what)
{
    if (const char* name = nameOf(kEventCodes, what, nullptr))
        return QLatin1String(name);
    return QStringLiteral("event %1").arg(what);
}

QString fourCharText(UInt32 code)
{
    QString text(4, u'.');
    for (int i = 0; i < 4; ++i) {
        const char c = char(code >> (24 - 8 * i));
        if (c >= 0x20 && c < 0x7F)
            text[i] = QLatin1Char(c);
    }
    return text;
}

QString modifierNames(UInt32 modifiers)
{
    QString text;
    for (const auto& bit : kModifiers) {
        if (modifiers & bit.key)
            text += (text.isEmpty() ? QString() : QStringLiteral(" ")) + QLatin1String(bit.name);
    }
    return text.isEmpty() ? QStringLiteral("-") : text;
}

QString markName(SInt16 mark)
{
    if (mark == 0)
        return QString();
    if (const char* name = nameOf(kMarks, mark, nullptr))
        return QLatin1String(name);
    if (mark > 0x20 && mark < 0x7F)
        return QString(QLatin1Char(char(mark)));
    return QString::number(mark);
}

QString rectText(qint64 left, qint64 top, qint64 right, qint64 bottom)
{
    return QStringLiteral("(%1,%2)-(%3,%4)").arg(left).arg(top).arg(right).arg(bottom);
}

} // namespace Velmar::Private::Inspector
