// The one lifetime rule for objects a host can dispose: an object whose deletion is deferred
// is never deleted while library code for it is on the stack.
//
// Two pieces make it hold. Every call into host code (handlers, action and click-loop
// procedures, timers, exporters) runs inside a HostCallScope, and the waits' explicit flush
// of deferred deletions (flushDeferredDeletions) does nothing while any such scope is open:
// a host that disposes from inside a handler and then waits does not pull the object out from
// under the library code that called the handler. Library code that holds an object across a
// host call keeps it with a KeepAlive; deleteWhenFree defers a deletion asked for meanwhile to
// the release of the last KeepAlive. After the call, the caller re-checks what it holds
// (KeepAlive::alive, or its object's own disposed mark) before touching it again.
#pragma once

#include <Velmar/HostCore.h>

#include <QObject>
#include <QPointer>

#include <exception>

namespace Velmar::Private {

// Counts the calls into host code on the stack.
class HostCallScope {
public:
    HostCallScope();
    ~HostCallScope();
    HostCallScope(const HostCallScope&) = delete;
    HostCallScope& operator=(const HostCallScope&) = delete;
    static int depth();
};

// Sends Qt's posted deferred deletions now, unless host code is on the stack (then they
// wait for the outermost wait, or for Qt's own loop).
void flushDeferredDeletions();

// Keeps `object` from being deleted through deleteWhenFree while this scope lives.
class KeepAlive {
public:
    explicit KeepAlive(QObject* object);
    ~KeepAlive();
    KeepAlive(const KeepAlive&) = delete;
    KeepAlive& operator=(const KeepAlive&) = delete;
    // False once the object is gone (deleted some other way than through deleteWhenFree).
    bool alive() const { return !m_object.isNull(); }

private:
    QObject* m_held; // the key of the hold, also once the object is gone
    QPointer<QObject> m_object;
};

// deleteLater, or, while a KeepAlive holds the object, deleteLater when the last one goes.
void deleteWhenFree(QObject* object);
// True while a KeepAlive holds `object`: it must not be deleted at once.
bool isKeptAlive(const QObject* object);

// Calls host code that may throw anything: what escapes is logged through LogXError and
// never unwinds through Qt. False when the call threw; `unknownText` is logged for what is
// neither an XError nor a std::exception.
template <typename Call>
bool callGuarded(Call&& call, const char* unknownText)
{
    HostCallScope scope;
    try {
        call();
        return true;
    } catch (const XError& error) {
        LogXError(error);
    } catch (const std::exception& error) {
        LogXError(XError("std::exception", error.what()));
    } catch (...) {
        LogXError(XError("", unknownText));
    }
    return false;
}

} // namespace Velmar::Private
