// Shared by the event tests: one log that records, in order, what each participant saw
// (assertions, handlers, waiters, windows, queue contents), and stand-ins for the windows
// and waiters the queue talks to through its hooks.
#pragma once

#include "TestSupport.h"

#include "events/EventQueue.h"
#include "events/EventQueueHooks.h"

#include <Velmar/HostCore.h>

#include <QHash>
#include <QSet>
#include <QStringList>

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

inline int windowNumber(AQtWindow* w)
{
    return int(quintptr(w) / 0x1000);
}

inline QString fourChars(UInt32 code)
{
    QString s;
    for (int shift = 24; shift >= 0; shift -= 8)
        s += QChar::fromLatin1(char((code >> shift) & 0xFF));
    return s;
}

// "mous/1", "vlmr/size", "wind/1@w2", "vlme/12 msg=5 skip"
inline QString describe(const EventQueueItem* item)
{
    if (!item)
        return QStringLiteral("<null>");
    QString s = item->eventClass == 0 ? QStringLiteral("null") : fourChars(item->eventClass);
    s += u'/';
    s += item->eventClass == Velmar::Private::kEventClassVelmar ? fourChars(item->eventKind)
                                                                : QString::number(item->eventKind);
    if (item->window)
        s += QStringLiteral("@w%1").arg(windowNumber(item->window));
    if (item->message)
        s += QStringLiteral(" msg=%1").arg(item->message);
    if (item->skipFlush)
        s += QStringLiteral(" skip");
    if (item->revoked)
        s += QStringLiteral(" revoked");
    return s;
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

// Answers every assertion dialog with "Ignore" and records its message line.
class AssertRecorder : public Velmar::AutomationListener {
public:
    AssertRecorder() { m_previous = Velmar::AutomationListenerManager::SetListener(this); }
    ~AssertRecorder() override { Velmar::AutomationListenerManager::SetListener(m_previous); }
    AssertRecorder(const AssertRecorder&) = delete;
    AssertRecorder& operator=(const AssertRecorder&) = delete;

    QString AnswerDialog(const QString&, const QString& text, const QString&) override
    {
        log() << QStringLiteral("assert: ") + text.section(u'\n', 0, 0);
        return QStringLiteral("Ignore");
    }

private:
    Velmar::AutomationListener* m_previous = nullptr;
};

inline QStringList assertsIn(const QStringList& entries)
{
    return entries.filter(QStringLiteral("assert: "));
}

// Answers every assertion with "Ignore" and keeps the questions, for tests that count them.
inline std::unique_ptr<VelmarTest::ScriptedAutomationListener> ignoreAssertions()
{
    return std::make_unique<VelmarTest::ScriptedAutomationListener>(QStringList{}, QStringLiteral("Ignore"));
}

// Windows as the queue sees them: deletion pending, a non-empty update region, a pending
// update event of their own. Installs the hooks for its lifetime and restores the old ones.
class FakeWindows {
public:
    FakeWindows()
    {
        Velmar::Private::WindowEventHooks hooks;
        hooks.isDeletePending = [](AQtWindow* w) { return state().deletePending.contains(w); };
        hooks.isUpdateRegionEmpty = [](AQtWindow* w) { return !state().dirty.contains(w); };
        hooks.countPendingUpdateEvents = [] { return UInt32(state().pending.size()); };
        hooks.findPendingUpdateEvent = [](Velmar::Private::PendingUpdatePredicate pred, void* data) {
            for (AQtWindow* w : state().order)
                if (state().pending.contains(w) && pred(state().pending[w].get(), data))
                    return state().pending[w].get();
            return static_cast<EventQueueItem*>(nullptr);
        };
        hooks.clearPendingUpdateEvents = [](Velmar::Private::PendingUpdatePredicate pred, void* data) {
            for (AQtWindow* w : state().order)
                if (state().pending.contains(w) && pred(state().pending[w].get(), data))
                    clearPending(w);
        };
        hooks.clearPendingUpdateEvent = clearPending;
        hooks.windowTitle = [](AQtWindow* w) { return QStringLiteral("Window %1").arg(windowNumber(w)); };
        hooks.legacyEventProcessing = [] { return state().legacy; };
        m_previous = Velmar::Private::SetWindowEventHooks(hooks);
        state() = State();
    }
    ~FakeWindows()
    {
        state() = State();
        Velmar::Private::SetWindowEventHooks(m_previous);
    }
    FakeWindows(const FakeWindows&) = delete;
    FakeWindows& operator=(const FakeWindows&) = delete;

    void setLegacy(bool on) { state().legacy = on; }
    void setDeletePending(AQtWindow* w) { state().deletePending.insert(w); }
    void setDirty(AQtWindow* w) { state().dirty.insert(w); }
    // Gives the window a pending update event, as a window with an invalid region has.
    EventQueueItem* addPendingUpdate(AQtWindow* w)
    {
        EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
        item->eventClass = Velmar::kEventClassWindow;
        item->eventKind = Velmar::kEventWindowUpdate;
        item->window = w;
        state().pending[w] = item;
        if (!state().order.contains(w))
            state().order << w;
        return item.get();
    }
    bool hasPendingUpdate(AQtWindow* w) const { return state().pending.contains(w); }

private:
    struct State {
        bool legacy = false;
        QSet<AQtWindow*> deletePending, dirty;
        QHash<AQtWindow*, EventQueueItemSmartPtr> pending;
        QList<AQtWindow*> order;
    };
    static State& state()
    {
        static State sState;
        return sState;
    }
    static void clearPending(AQtWindow* w)
    {
        log() << QStringLiteral("clear pending w%1").arg(windowNumber(w));
        state().pending.remove(w);
    }
    Velmar::Private::WindowEventHooks m_previous;
};

// A waiter as the queue sees it: whether one runs, and the plain waiter a flush makes.
class FakeWaiter {
public:
    explicit FakeWaiter(bool active)
    {
        sActive = active;
        Velmar::Private::WaiterHooks hooks;
        hooks.isWaiterActive = [] { return sActive; };
        hooks.beginFlushWaiter = []() -> void* {
            log() << QStringLiteral("waiter begin");
            return &sActive;
        };
        hooks.endFlushWaiter = [](void*) { log() << QStringLiteral("waiter end"); };
        m_previous = Velmar::Private::SetWaiterHooks(hooks);
    }
    ~FakeWaiter() { Velmar::Private::SetWaiterHooks(m_previous); }
    FakeWaiter(const FakeWaiter&) = delete;
    FakeWaiter& operator=(const FakeWaiter&) = delete;

private:
    static inline bool sActive = false;
    Velmar::Private::WaiterHooks m_previous;
};

// A fresh item of the given class and kind for a window.
inline EventQueueItemSmartPtr makeItem(UInt32 cls, UInt32 kind, AQtWindow* window = nullptr, UInt32 message = 0)
{
    EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
    item->eventClass = cls;
    item->eventKind = kind;
    item->window = window;
    item->message = message;
    return item;
}

} // namespace EventTest
