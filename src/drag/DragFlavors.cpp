// The flavour and accessor calls: outgoing bytes, incoming text, items, modifiers, mouse.
#include <Velmar/Drag.h>
#include <Velmar/Events.h>
#include <Velmar/TextUtils.h>

#include "cursors/CursorPrivate.h"
#include "drag/DragPrivate.h"
#include "events/KeyModifiers.h"
#include "foundation/Conversions.h"
#include "foundation/LiveHandles.h"

#include <QCursor>
#include <QDrag>
#include <QPixmap>

#include <cstring>

namespace Velmar {

using namespace Private;

namespace {

// A drag the call may use: null is badDragRefErr (after the call's own assertion, when it has
// one), a disposed one "IsValidDrag(drag)".
bool usableDrag(Drag* drag, bool assertNull)
{
    if (!drag) {
        if (assertNull)
            VELMAR_ASSERT(false, "theDrag");
        return false;
    }
    return VELMAR_LIVE(drag, "IsValidDrag(drag)");
}

} // namespace

namespace Private {

QByteArray dropText(const QMimeData* data)
{
    return data && data->hasText() ? MakeLocal8Bit(data->text()) : QByteArray();
}

QPixmap& dragCursorPixmap()
{
    static QPixmap sPixmap;
    return sPixmap;
}

} // namespace Private

OSErr AddDragItemFlavor(Drag* drag, SInt64, FlavorType, const void* data, SInt32 size, FlavorFlags)
{
    if (!usableDrag(drag, true))
        return badDragRefErr;
    if (data && size > 0)
        drag->mimeData()->setData(QStringLiteral("application/x-dnditemdata"),
            QByteArray(static_cast<const char*>(data), size));
    return noErr;
}

OSErr GetFlavorDataSize(Drag* drag, SInt64, FlavorType flavor, SInt32* size)
{
    if (!usableDrag(drag, false))
        return badDragRefErr;
    const QMimeData* data = drag->dropMimeData();
    if (!VELMAR_ASSERT(size, "dataSize") || !VELMAR_ASSERT(data, "mimeData"))
        return cantGetFlavorErr;
    if (flavor != kDragFlavorTypeText)
        return badDragFlavorErr;
    const QByteArray text = dropText(data);
    if (text.isEmpty())
        return cantGetFlavorErr;
    *size = SInt32(text.size() - 1);
    return noErr;
}

// Counts the whole block, its zero too (GetFlavorDataSize does not): a host asking for
// one byte more gets the terminator.
OSErr GetFlavorData(Drag* drag, SInt64, FlavorType flavor, void* data, SInt32* size, UInt32 offset)
{
    if (!usableDrag(drag, false))
        return badDragRefErr;
    const QMimeData* drop = drag->dropMimeData();
    if (!VELMAR_ASSERT(data, "dataPtr") || !VELMAR_ASSERT(size, "dataSize")
        || !VELMAR_ASSERT(drop, "mimeData"))
        return cantGetFlavorErr;
    if (flavor != kDragFlavorTypeText)
        return badDragFlavorErr;
    const QByteArray text = dropText(drop);
    if (text.isEmpty())
        return cantGetFlavorErr;
    const qint64 available = qint64(text.size()) - qint64(offset);
    const SInt32 count =
        available <= 0 ? 0 : SInt32(std::min<qint64>(std::max<SInt32>(*size, 0), available));
    if (count > 0)
        std::memcpy(data, text.constData() + offset, size_t(count));
    *size = count;
    return noErr;
}

OSErr CountDragItems(Drag* drag, UInt16* numItems)
{
    if (!VELMAR_ASSERT(numItems, "numItems"))
        return paramErr;
    if (!usableDrag(drag, false))
        return badDragRefErr;
    const QMimeData* data = drag->dropMimeData();
    *numItems = 0;
    if (!data)
        return noErr;
    if (data->hasUrls())
        *numItems = UInt16(std::min<qsizetype>(data->urls().size(), UINT16_MAX));
    else if (data->hasText() || !data->formats().isEmpty())
        *numItems = 1;
    return noErr;
}

OSErr GetDragModifiers(
    Drag* drag, SInt16* modifiers, SInt16* mouseDownModifiers, SInt16* mouseUpModifiers)
{
    if (!usableDrag(drag, true))
        return badDragRefErr;
    if (modifiers)
        *modifiers = SInt16(GetCurrentKeyModifiers());
    if (mouseDownModifiers)
        *mouseDownModifiers = 0;
    if (mouseUpModifiers)
        *mouseUpModifiers = SInt16(macModifiers(Qt::KeyboardModifiers(drag->dropModifiers())));
    return noErr;
}

OSErr GetDragMouse(Drag*, Point* mouse, Point* globalPinnedMouse)
{
    const Point where = toPoint(QCursor::pos());
    if (mouse)
        *mouse = where;
    if (globalPinnedMouse)
        *globalPinnedMouse = where;
    return noErr;
}

OSErr GetDragAttributes(Drag* drag, DragAttributes* flags)
{
    if (!usableDrag(drag, false))
        return badDragRefErr;
    if (flags)
        *flags = drag->isTracking() ? DragAttributes(kDragInsideSenderApplication) : 0;
    return noErr;
}

OSErr GetDragItemReferenceNumber(Drag* drag, UInt16 index, DragItemRef* item)
{
    if (!usableDrag(drag, false))
        return badDragRefErr;
    if (item)
        *item = index;
    return noErr;
}

const QMimeData* GetDragData(Drag* drag)
{
    return usableDrag(drag, false) ? drag->dropMimeData() : nullptr;
}

// The data is all there when the drag starts: nothing is sent on request.
OSErr SetDragSendProc(Drag* drag, DragSendDataUPP, void*)
{
    return usableDrag(drag, false) ? OSErr(noErr) : OSErr(badDragRefErr);
}

// The picture of the cursor (a shape cursor has none: Qt's own drag cursor stays).
void SetDragCursor(CursPtr* cursor)
{
    if (!cursor || !VELMAR_CHECK_CURSOR(cursor))
        return;
    dragCursorPixmap() = cursor->getCursor().pixmap();
    if (Drag* drag = DragInstance(); drag && drag->m_qdrag && !dragCursorPixmap().isNull())
        drag->m_qdrag->setDragCursor(dragCursorPixmap(), Qt::MoveAction);
}

Boolean IsDragTracking(Drag* drag)
{
    return usableDrag(drag, false) && drag->isTracking();
}

} // namespace Velmar
