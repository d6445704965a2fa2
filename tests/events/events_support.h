// Shared by the event tests: one log of what each participant saw, in order, and stand-ins
// for the windows and waiters the queue talks to through its hooks.
#pragma once

#include "TestSupport.h"

#include "events/EventQueue.h"
#include "events/EventQueueHooks.h"

#include <Velmar/HostCore.h>

#include <QSet>
#include <QStringList>

#include <algorithm>
#include <memory>

namespace EventTest {

using Velmar::AQtWindow;
using Velmar::UInt32;
using Velmar::Private::EventQueueItem;
using Velmar::Private::EventQueueItemSmartPtr;

inline AQtWindow* fakeWindow(int n)
{
    return reinterpret_cast<AQtWindow*>(quintptr(0x1000) * quintptr(n));
}

inline QString fourChars(UInt32 code)
{
    const char c[4] = {char(code >> 24), char(code >> 16), char(code >> 8), char(code)};
    return QString::fromLatin1(c, 4);
}

// "mous/1", "vlmr/size", "wind/1@w2", "vlme/12 msg=5 skip"
inline QString describe(const EventQueueItem* item)
{
    if (!item)
        return QStringLiteral("<null>");
    QString s = (item->eventClass ? fourChars(item->eventClass) : QStringLiteral("null")) + u'/'
        + (item->eventClass == Velmar::Private::kEventClassVelmar ? fourChars(item->eventKind)
                                                                  : QString::number(item->eventKind));
    if (item->window)
        s += QStringLiteral("@w%1").arg(quintptr(item->window) / 0x1000);
    if (item->message)
        s += QStringLiteral(" msg=%1").arg(item->message);
    return s + (item->skipFlush ? " skip" : "") + (item->revoked ? " revoked" : "");
}

inline QStringList queueSnapshot()
{
    QStringList out;
    for (const EventQueueItemSmartPtr& item : Velmar::Private::gMainEventQueue.items())
        out << describe(item.get());
    return out;
}

// Everything that happened, in order.
inline QStringList& log()
{
    static QStringList sLog;
    return sLog;
}

// Appends `entry` unless it repeats the last one: a run of calls then shows once, however
// often the Qt loop spun.
inline void noteOnce(QStringList& seen, const QString& entry)
{
    if (seen.isEmpty() || seen.last() != entry)
        seen << entry;
}

inline QStringList assertsIn(const QStringList& entries)
{
    return entries.filter(QStringLiteral("assert: "));
}

// Answers every assertion dialog with "Ignore" and logs its first line.
class AssertRecorder : public Velmar::AutomationListener {
public:
    AssertRecorder() : m_previous(Velmar::AutomationListenerManager::SetListener(this)) {}
    ~AssertRecorder() override { Velmar::AutomationListenerManager::SetListener(m_previous); }
    QString AnswerDialog(const QString&, const QString& text, const QString&) override
    {
        log() << QStringLiteral("assert: ") + VelmarTest::assertionText(text);
        return QStringLiteral("Ignore");
    }

private:
    Velmar::AutomationListener* m_previous;
};

// The start of a case that counts assertions: an empty log of what was seen, and a listener
// that answers every assertion with "Ignore" and keeps the questions.
inline std::unique_ptr<VelmarTest::ScriptedAutomationListener> startCase(QStringList& seen)
{
    seen.clear();
    return std::make_unique<VelmarTest::ScriptedAutomationListener>(QStringList{}, QStringLiteral("Ignore"));
}

inline EventQueueItemSmartPtr makeItem(UInt32 cls, UInt32 kind, AQtWindow* window = nullptr, UInt32 message = 0)
{
    EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
    item->eventClass = cls;
    item->eventKind = kind;
    item->window = window;
    item->message = message;
    return item;
}

// Windows as the queue sees them: a non-empty update region, pending update events of their
// own, legacy processing. Installs the hooks for its lifetime.
class FakeWindows {
public:
    FakeWindows()
    {
        using Velmar::Private::PendingUpdatePredicate;
        Velmar::Private::WindowEventHooks h;
        h.isUpdateRegionEmpty = [](AQtWindow* w) { return !s().dirty.contains(w); };
        h.countPendingUpdateEvents = [] { return UInt32(s().pending.size()); };
        h.findPendingUpdateEvent = [](PendingUpdatePredicate pred, void* data) -> EventQueueItem* {
            for (const EventQueueItemSmartPtr& p : s().pending)
                if (pred(p.get(), data))
                    return p.get();
            return nullptr;
        };
        h.clearPendingUpdateEvents = [](PendingUpdatePredicate pred, void* data) {
            const QList<EventQueueItemSmartPtr> all = s().pending;
            for (const EventQueueItemSmartPtr& p : all)
                if (pred(p.get(), data))
                    clearPending(p->window);
        };
        h.clearPendingUpdateEvent = clearPending;
        h.legacyEventProcessing = [] { return s().legacy; };
        m_previous = Velmar::Private::SetWindowEventHooks(h);
    }
    ~FakeWindows()
    {
        s() = State();
        Velmar::Private::SetWindowEventHooks(m_previous);
    }

    void setLegacy(bool on) { s().legacy = on; }
    void setDirty(AQtWindow* w) { s().dirty.insert(w); }
    EventQueueItem* addPendingUpdate(AQtWindow* w)
    {
        s().pending << makeItem(Velmar::kEventClassWindow, Velmar::kEventWindowUpdate, w);
        return s().pending.last().get();
    }
    bool hasPendingUpdate(AQtWindow* w) const
    {
        return std::any_of(s().pending.begin(), s().pending.end(), [w](auto& p) { return p->window == w; });
    }

private:
    struct State {
        bool legacy = false;
        QSet<AQtWindow*> dirty;
        QList<EventQueueItemSmartPtr> pending; // in the order the windows got them
    };
    static State& s()
    {
        static State sState;
        return sState;
    }
    static void clearPending(AQtWindow* w)
    {
        log() << QStringLiteral("clear pending w%1").arg(quintptr(w) / 0x1000);
        s().pending.removeIf([w](const EventQueueItemSmartPtr& p) { return p->window == w; });
    }
    Velmar::Private::WindowEventHooks m_previous;
};

// A waiter as the queue sees it: whether one runs, and the plain waiter a flush makes.
class FakeWaiter {
public:
    explicit FakeWaiter(bool active)
    {
        sActive = active;
        Velmar::Private::WaiterHooks h;
        h.isWaiterActive = [] { return sActive; };
        h.beginFlushWaiter = []() -> void* {
            log() << QStringLiteral("waiter begin");
            return &sActive;
        };
        h.endFlushWaiter = [](void*) { log() << QStringLiteral("waiter end"); };
        m_previous = Velmar::Private::SetWaiterHooks(h);
    }
    ~FakeWaiter() { Velmar::Private::SetWaiterHooks(m_previous); }

private:
    static inline bool sActive = false;
    Velmar::Private::WaiterHooks m_previous;
};

} // namespace EventTest
