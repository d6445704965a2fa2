// The Drag Manager on Qt's drag and drop: one drag at a time, its data as
// "application/x-dnditemdata" bytes (and text or files a host adds), TrackDrag running a Qt
// drag pictured by the host's outline region, and tracking and receive handlers called as
// drags enter, move over, leave and drop on the library's windows.
#pragma once

#include <Velmar/AQtWindow.h>
#include <Velmar/Events.h>
#include <Velmar/MacErrors.h>
#include <Velmar/MacTypes.h>
#include <Velmar/QDTypes.h>

#include <QMimeData>
#include <QObject>
#include <QPointer>

class QDrag;

namespace Velmar {

class CursPtr;

using DragRef = Drag*;
using DragItemRef = UInt32;
using FlavorType = OSType;
using FlavorFlags = UInt32;
using DragAttributes = UInt32;
using DragSendDataUPP = OSErr (*)(FlavorType type, void* refCon, DragItemRef item, DragRef drag);

// Tracking messages.
enum : DragTrackingMessage {
    kDragTrackingEnterHandler = 1,
    kDragTrackingEnterWindow = 2,
    kDragTrackingInWindow = 3,
    kDragTrackingLeaveWindow = 4,
    kDragTrackingLeaveHandler = 5,
};

enum : DragAttributes {
    kDragHasLeftSenderWindow = 1 << 0,
    kDragInsideSenderApplication = 1 << 1,
    kDragInsideSenderWindow = 1 << 2,
};

enum : FlavorType {
    kDragFlavorTypeText = FOUR_CHAR_CODE("TEXT"),
};

// The outgoing data. When a drop outside the application asks for the file list, the host's
// exporter is told once (runExport, through DragExportTransmitter) so that it writes the
// files and replaces the URL list; every other request for the list (while dragging, or from
// the library's own windows) is requestFileList.
class VELMAR_EXPORT MimeData : public QMimeData {
    Q_OBJECT

public:
    MimeData();
    QStringList formats() const override;
    bool exported() const { return m_exported; }

    // Where the drag this data travels with is (TrackDrag keeps it up to date).
    enum class Phase { Idle, Dragging, DroppedOutside, Ended };
    Phase phase() const { return m_phase; }
    void setPhase(Phase phase) { m_phase = phase; }

Q_SIGNALS:
    void initData(QMimeData* data);
    void runExport(QMimeData* data);
    void requestFileList(QMimeData* data);

protected:
    QVariant retrieveData(const QString& mimeType, QMetaType type) const override;

private:
    mutable bool m_exported = false;
    Phase m_phase = Phase::Idle;
};

// Where hosts connect their exporter: every MimeData's signals arrive here too.
class VELMAR_EXPORT DragExportTransmitter : public QObject {
    Q_OBJECT

public:
    static DragExportTransmitter* Instance();

Q_SIGNALS:
    void initData(QMimeData* data);
    void runExport(QMimeData* data);
    void requestFileList(QMimeData* data);
};

// The one drag (NewDrag makes it, DisposeDrag ends it, DragInstance finds it). While a drag
// from outside is over a window, its data is recorded on the instance when there is one.
class VELMAR_EXPORT Drag : public QObject {
    Q_OBJECT

public:
    Drag();
    ~Drag() override;

    // The outgoing data, made on first use; a host may add text or URLs to it.
    MimeData* mimeData();
    const QMimeData* dropMimeData() const { return m_dropMimeData; }
    AQtWindow* targetWindow() const { return m_targetWindow; }
    bool isTracking() const { return m_qdrag != nullptr; }

    // The receiving side (the library's windows call these).
    void setDropData(const QMimeData* data) { m_dropMimeData = data; }
    void setDropModifiers(Qt::KeyboardModifiers modifiers) { m_modifiers = UInt32(modifiers); }
    UInt32 dropModifiers() const { return m_modifiers; }
    void setTarget(AQtWindow* window);
    void clearTarget();

    QDrag* m_qdrag = nullptr;
    MimeData* m_mimeData = nullptr;

protected:
    void timerEvent(QTimerEvent* event) override;

private:
    QPointer<const QMimeData> m_dropMimeData;
    UInt32 m_modifiers = 0;
    QPointer<AQtWindow> m_targetWindow;
    int m_timerId = 0;
};

VELMAR_EXPORT OSErr NewDrag(Drag** outDrag);
VELMAR_EXPORT OSErr DisposeDrag(Drag* drag);
VELMAR_EXPORT Drag* DragInstance();
// The bytes become the drag's "application/x-dnditemdata" (the item, flavour and flags are
// not kept apart).
VELMAR_EXPORT OSErr AddDragItemFlavor(
    Drag* drag, SInt64 item, FlavorType flavor, const void* data, SInt32 size, FlavorFlags flags);
// Only 'TEXT' of the data over the window is served, in the host's encoding.
VELMAR_EXPORT OSErr GetFlavorDataSize(Drag* drag, SInt64 item, FlavorType flavor, SInt32* size);
VELMAR_EXPORT OSErr GetFlavorData(
    Drag* drag, SInt64 item, FlavorType flavor, void* data, SInt32* size, UInt32 offset);
VELMAR_EXPORT OSErr CountDragItems(Drag* drag, UInt16* numItems);
VELMAR_EXPORT OSErr GetDragModifiers(
    Drag* drag, SInt16* modifiers, SInt16* mouseDownModifiers, SInt16* mouseUpModifiers);
VELMAR_EXPORT OSErr GetDragMouse(Drag* drag, Point* mouse, Point* globalPinnedMouse);
VELMAR_EXPORT OSErr GetDragAttributes(Drag* drag, DragAttributes* flags);
VELMAR_EXPORT OSErr GetDragItemReferenceNumber(Drag* drag, UInt16 index, DragItemRef* item);
// The data of the drag over the window (null when none).
VELMAR_EXPORT const QMimeData* GetDragData(Drag* drag);
VELMAR_EXPORT OSErr SetDragSendProc(Drag* drag, DragSendDataUPP proc, void* refCon);
// The cursor the running drag shows.
VELMAR_EXPORT void SetDragCursor(CursPtr* cursor);
VELMAR_EXPORT Boolean IsDragTracking(Drag* drag);
// Runs the drag from the mouse-down `event` pictured by `region` (global coordinates). The
// answer is dragNotAcceptedErr in every case, a drop included: receive handlers hear of drops.
VELMAR_EXPORT OSErr TrackDrag(Drag* drag, const EventRecord* event, RgnHandle region);

// With a window: that window's handlers; without: the application's, called after every
// window's own.
VELMAR_EXPORT OSErr InstallTrackingHandler(
    DragTrackingHandlerUPP handler, WindowRef window, void* refCon);
VELMAR_EXPORT OSErr RemoveTrackingHandler(DragTrackingHandlerUPP handler, WindowRef window);
VELMAR_EXPORT OSErr InstallReceiveHandler(
    DragReceiveHandlerUPP handler, WindowRef window, void* refCon);
VELMAR_EXPORT OSErr RemoveReceiveHandler(DragReceiveHandlerUPP handler, WindowRef window);

} // namespace Velmar
