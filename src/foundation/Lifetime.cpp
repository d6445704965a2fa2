#include "foundation/Lifetime.h"

#include <QCoreApplication>
#include <QHash>
#include <QSet>

namespace Velmar::Private {

namespace {

int gHostCallDepth = 0;

// Objects held by KeepAlive scopes, with their count, and those whose deletion waits for the
// count to fall to zero.
struct Holds {
    QHash<QObject*, int> counts;
    QSet<QObject*> deleteWhenFree;
};

Holds& holds()
{
    static auto* sHolds = new Holds; // never destroyed: scopes may end during shutdown
    return *sHolds;
}

} // namespace

HostCallScope::HostCallScope()
{
    ++gHostCallDepth;
}

HostCallScope::~HostCallScope()
{
    --gHostCallDepth;
}

int HostCallScope::depth()
{
    return gHostCallDepth;
}

void flushDeferredDeletions()
{
    if (gHostCallDepth == 0)
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
}

KeepAlive::KeepAlive(QObject* object) : m_held(object), m_object(object)
{
    if (object)
        ++holds().counts[object];
}

KeepAlive::~KeepAlive()
{
    if (!m_held)
        return;
    Holds& h = holds();
    auto it = h.counts.find(m_held);
    if (it == h.counts.end() || --it.value() > 0)
        return;
    h.counts.erase(it);
    // Gone by other means meanwhile: only the count was left to drop.
    if (h.deleteWhenFree.remove(m_held) && m_object)
        m_object->deleteLater();
}

bool isKeptAlive(const QObject* object)
{
    return object && holds().counts.contains(const_cast<QObject*>(object));
}

void deleteWhenFree(QObject* object)
{
    if (!object)
        return;
    Holds& h = holds();
    if (!h.counts.contains(object)) {
        object->deleteLater();
        return;
    }
    h.deleteWhenFree.insert(object);
}

} // namespace Velmar::Private
