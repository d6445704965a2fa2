#include "quickdraw/TextSource.h"

#include <Velmar/Diagnostics.h>
#include <Velmar/TextUtils.h>

namespace Velmar::Private {

QString bytesText(const void* text, SInt16 first, SInt16 count)
{
    if (!text || count <= 0)
        return QString();
    return MakeQString(static_cast<const char*>(text) + first, count);
}

QString charText(SInt16 ch)
{
    const char bytes[2] = {char(UInt16(ch) >> 8), char(ch)};
    return UInt16(ch) > 0xFF ? MakeQString(bytes, 2) : MakeQString(bytes + 1, 1);
}

bool validRange(int first, int count, const char* call)
{
    if (first >= 0 && count >= 0)
        return true;
    VelmarLog(kLogQuickDraw, "warning: %s: first %d or count %d is negative", call, first, count);
    return false;
}

} // namespace Velmar::Private
