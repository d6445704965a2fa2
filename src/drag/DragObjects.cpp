// The drag object, its outgoing data and the exporter's transmitter.
#include <Velmar/Drag.h>

#include "drag/DragPrivate.h"
#include "foundation/Lifetime.h"
#include "foundation/LiveHandles.h"

#include <QTimerEvent>

namespace Velmar {

using namespace Private;

namespace {

// The 100 ms repeat of the in-window call while a drag stands still over a window.
constexpr int kInWindowRepeatMs = 100;

QPointer<Drag>& instance()
{
    static QPointer<Drag> sInstance;
    return sInstance;
}

const QString kUriList = QStringLiteral("text/uri-list");

} // namespace

// ---- MimeData --------------------------------------------------------------------------------

MimeData::MimeData()
{
    DragExportTransmitter* transmitter = DragExportTransmitter::Instance();
    connect(this, &MimeData::initData, transmitter, &DragExportTransmitter::initData);
    connect(this, &MimeData::runExport, transmitter, &DragExportTransmitter::runExport);
    connect(this, &MimeData::requestFileList, transmitter, &DragExportTransmitter::requestFileList);
}

QStringList MimeData::formats() const
{
    QStringList formats = QMimeData::formats();
    if (!formats.contains(kUriList))
        formats << kUriList;
    return formats;
}

QVariant MimeData::retrieveData(const QString& mimeType, QMetaType type) const
{
    if (mimeType == kUriList) {
        auto* self = const_cast<MimeData*>(this);
        // The exporter is host code: it may dispose of the drag, and so of this data.
        KeepAlive keep(self);
        HostCallScope hostCode;
        if (!m_exported && droppedOutside(m_phase)) {
            m_exported = true;
            Q_EMIT self->runExport(self);
        } else {
            Q_EMIT self->requestFileList(self);
        }
    }
    return QMimeData::retrieveData(mimeType, type);
}

DragExportTransmitter* DragExportTransmitter::Instance()
{
    static auto* sTransmitter = new DragExportTransmitter;
    return sTransmitter;
}

// ---- Drag -------------------------------------------------------------------------------------

Drag::Drag()
{
    LiveHandles<Drag>::instance().add(this);
}

Drag::~Drag()
{
    LiveHandles<Drag>::instance().remove(this);
    // Handed to a Qt drag, the data belongs to it.
    if (!m_qdrag)
        delete m_mimeData;
}

MimeData* Drag::mimeData()
{
    if (!m_mimeData)
        m_mimeData = new MimeData;
    return m_mimeData;
}

void Drag::setTarget(AQtWindow* window)
{
    m_targetWindow = window;
    if (m_timerId)
        killTimer(m_timerId);
    m_timerId = window ? startTimer(kInWindowRepeatMs) : 0;
}

void Drag::clearTarget()
{
    setTarget(nullptr);
}

void Drag::timerEvent(QTimerEvent* event)
{
    if (event->timerId() != m_timerId)
        return;
    if (AQtWindow* window = m_targetWindow.data(); window && !window->IsDeletePending())
        callTrackingHandlers(window, kDragTrackingInWindow);
    else
        clearTarget();
}

// ---- The drag's life --------------------------------------------------------------------------

OSErr NewDrag(Drag** outDrag)
{
    if (!outDrag)
        return noErr;
    installDragReceiving();
    if (!instance())
        instance() = new Drag;
    *outDrag = instance();
    return noErr;
}

OSErr DisposeDrag(Drag* drag)
{
    if (!VELMAR_ASSERT(drag && drag == DragInstance(), "theDrag == DragInstance()"))
        return noErr;
    instance() = nullptr;
    // A drag disposed of while it runs goes once Qt's drag loop (and TrackDrag) is done with it.
    if (drag->isTracking() || isKeptAlive(drag))
        deleteWhenFree(drag);
    else
        delete drag;
    return noErr;
}

Drag* DragInstance()
{
    return instance();
}

} // namespace Velmar
