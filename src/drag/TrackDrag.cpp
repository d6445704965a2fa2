// TrackDrag: the host's outline as the drag's picture, the start check, then Qt's drag.
#include <Velmar/AQtWindow.h>
#include <Velmar/Cursors.h>
#include <Velmar/Drag.h>
#include <Velmar/MacErrors.h>

#include "drag/DragPrivate.h"
#include "drag/DragStartChecker.h"
#include "drag/DragTabSwitcher.h"
#include "foundation/Conversions.h"
#include "foundation/Lifetime.h"
#include "foundation/LiveHandles.h"

#include <QApplication>
#include <QDir>
#include <QDrag>
#include <QPainter>
#include <QPixmap>
#include <QUrl>

namespace Velmar {

using namespace Private;

namespace {

// The file a drag without data offers; the exporter replaces it when the drop is real.
const QString kPlaceholderFile = QStringLiteral("/FDE8B3B7-D06A-44ee-BC5E-C296196152BA.txt");

// The outline: every rectangle of the region in translucent grey with a translucent black
// edge, on a transparent picture one pixel larger on every side.
QPixmap outlinePicture(const QRegion& region)
{
    const QRect box = region.boundingRect();
    QPixmap picture(box.size() + QSize(2, 2));
    picture.fill(Qt::transparent);
    QPainter painter(&picture);
    QColor fill(Qt::gray);
    fill.setAlpha(127);
    QColor edge(Qt::black);
    edge.setAlpha(127);
    painter.setBrush(fill);
    painter.setPen(QPen(edge, 1, Qt::SolidLine, Qt::SquareCap, Qt::BevelJoin));
    for (const QRect& r : region)
        painter.drawRect(r.translated(-box.topLeft()));
    return picture;
}

QWidget* sourceWidget(const EventRecord* event)
{
    if (event->window && isLive(event->window))
        return event->window;
    return QApplication::widgetAt(toQPoint(event->where));
}

// The source widget's cursor for the move action; a 32x32 picture keeps only its arrow.
QPixmap moveCursor(QWidget* source)
{
    if (!dragCursorPixmap().isNull())
        return dragCursorPixmap();
    const QPixmap cursor = source->cursor().pixmap();
    if (cursor.size() == QSize(32, 32))
        return cursor.copy(5, 10, 27, 22);
    return cursor;
}

struct TrackingScope {
    ~TrackingScope() { dragCursorPixmap() = QPixmap(); }
};

} // namespace

OSErr TrackDrag(Drag* drag, const EventRecord* event, RgnHandle region)
{
    if (!VELMAR_ASSERT(event, "theEvent"))
        return paramErr;
    if (!drag || !VELMAR_LIVE(drag, "IsValidDrag(drag)"))
        return badDragRefErr;
    if (drag->isTracking()) // a handler started another drag from inside this one
        return dragNotAcceptedErr;
    QWidget* source = sourceWidget(event);
    if (!source)
        return dragNotAcceptedErr;
    // Disposed by a handler while it runs, the drag stays until this call is done.
    KeepAlive keep(drag);
    const QPointer<Drag> alive(drag);
    const QPointer<QWidget> sourceAlive(source);

    auto* qdrag = new QDrag(source);
    if (!drag->m_mimeData) {
        MimeData* data = drag->mimeData();
        data->setUrls({QUrl::fromLocalFile(QDir::tempPath() + kPlaceholderFile)});
        data->setData(QStringLiteral("application/x-dnditemdata"), QByteArray());
    }
    {
        HostCallScope hostCode;
        Q_EMIT drag->m_mimeData->initData(drag->m_mimeData);
    }
    if (!alive || DragInstance() != drag) { // the host's exporter disposed of it
        delete qdrag;
        return dragNotAcceptedErr;
    }
    qdrag->setMimeData(drag->m_mimeData);
    drag->m_qdrag = qdrag;

    const QRegion outline = region && isLive(region) ? *region : QRegion();
    if (!outline.isEmpty()) {
        qdrag->setPixmap(outlinePicture(outline));
        qdrag->setHotSpot(toQPoint(event->where) - outline.boundingRect().topLeft());
    }
    qdrag->setDragCursor(moveCursor(source), Qt::MoveAction);

    TrackingScope tracking;
    DragStartChecker checker(source, toQPoint(event->where));
    if (checker.run() && sourceAlive) {
        DragTabSwitcher tabs;
        const QPointer<MimeData> data(drag->m_mimeData);
        const QPointer<QDrag> running(qdrag);
        data->setPhase(MimeData::Phase::Dragging);
        const Qt::DropAction action = qdrag->exec(Qt::MoveAction, Qt::MoveAction);
        // Accepted, and by no window of ours: another application has it.
        const bool outside = action != Qt::IgnoreAction && running && !running->target();
        if (data)
            data->setPhase(outside ? MimeData::Phase::DroppedOutside : MimeData::Phase::Ended);
    } else {
        deleteWhenFree(qdrag); // never run: ours to delete
    }
    // Qt deletes its drag (and the data it owns) itself: another application may still ask
    // for the data after the drop.
    if (alive) {
        alive->m_qdrag = nullptr;
        alive->m_mimeData = nullptr;
        alive->clearTarget();
    }
    InitCursor();
    return dragNotAcceptedErr;
}

} // namespace Velmar
