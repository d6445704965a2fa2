// Printable names for the values the inspector shows.
#pragma once

#include <Velmar/MacTypes.h>

#include <QString>

namespace Velmar::Private::Inspector {

// "document", "floating", ...; "class N" for a class without a name.
QString windowClassName(UInt32 windowClass);
// The classic event code: "mouseDown", "updateEvt", ...
QString eventCodeName(UInt16 what);
// A four-character code as text, unprintable bytes as '.'.
QString fourCharText(UInt32 code);
// A classic modifier word: "cmd shift option ..." or "-".
QString modifierNames(UInt32 modifiers);
// An item's mark character: "checkMark", a printable character, or its number.
QString markName(SInt16 mark);
// "(left,top)-(right,bottom)".
QString rectText(qint64 left, qint64 top, qint64 right, qint64 bottom);

} // namespace Velmar::Private::Inspector
