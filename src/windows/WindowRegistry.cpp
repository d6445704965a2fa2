// Which windows exist, the front-to-back window list and the dirty-port set.
#include "windows/WindowPrivate.h"

#include <Velmar/Windows.h>

#include <algorithm>

namespace Velmar::Private {

namespace {

std::vector<AQtWindow*>& live()
{
    static auto* sLive = new std::vector<AQtWindow*>;
    return *sLive;
}

std::vector<AQtWindow*>& dirtyPorts()
{
    static auto* sDirty = new std::vector<AQtWindow*>;
    return *sDirty;
}

template <typename T>
bool eraseOne(std::vector<T*>& list, const T* item)
{
    auto it = std::find(list.begin(), list.end(), item);
    if (it == list.end())
        return false;
    list.erase(it);
    return true;
}

} // namespace

const std::vector<AQtWindow*>& liveWindows()
{
    return live();
}

void registerWindow(AQtWindow* window)
{
    live().push_back(window);
    LiveHandles<AQtWindow>::instance().add(window);
}

void unregisterWindow(AQtWindow* window)
{
    LiveHandles<AQtWindow>::instance().remove(window);
    eraseOne(live(), window);
    eraseOne(windowList(), window);
    eraseOne(dirtyPorts(), window);
}

bool isLiveWindow(const AQtWindow* window, const char* file, int line, const char* function)
{
    return checkLive(window, "IsValidWindow(window)", file, line, function);
}

bool isUsableWindow(const AQtWindow* window, const char* file, int line, const char* function)
{
    return isLiveWindow(window, file, line, function) && !window->IsDeletePending();
}

std::vector<AQtWindow*>& windowList()
{
    static auto* sList = new std::vector<AQtWindow*>;
    return *sList;
}

void listInsertFront(AQtWindow* window)
{
    eraseOne(windowList(), window);
    windowList().insert(windowList().begin(), window);
}

void listRemove(AQtWindow* window)
{
    eraseOne(windowList(), window);
}

void listMoveToFront(AQtWindow* window)
{
    auto& list = windowList();
    if (!list.empty() && list.front() == window)
        return;
    if (eraseOne(list, window))
        list.insert(list.begin(), window);
}

bool listContains(const AQtWindow* window)
{
    const auto& list = windowList();
    return std::find(list.begin(), list.end(), window) != list.end();
}

void dirtyPortSetAdd(AQtWindow* window)
{
    if (std::find(dirtyPorts().begin(), dirtyPorts().end(), window) == dirtyPorts().end())
        dirtyPorts().push_back(window);
}

void dirtyPortSetRemove(AQtWindow* window)
{
    eraseOne(dirtyPorts(), window);
}

std::vector<QPointer<AQtWindow>> dirtyPortSetSnapshot()
{
    return std::vector<QPointer<AQtWindow>>(dirtyPorts().begin(), dirtyPorts().end());
}

QPointer<AQtWindow>& activeWindowRecord()
{
    static auto* sActive = new QPointer<AQtWindow>;
    return *sActive;
}

QPointer<AQtWindow>& userFocusRecord()
{
    static auto* sFocus = new QPointer<AQtWindow>;
    return *sFocus;
}

QSize clampedWindowSize(const QSize& size, const char* call)
{
    const QSize clamped(qBound(1, size.width(), kMaxWindowSide), qBound(1, size.height(), kMaxWindowSide));
    if (clamped != size)
        VelmarLog(kLogWindowManagement, "%s: window size %dx%d clamped to %dx%d", call,
                  size.width(), size.height(), clamped.width(), clamped.height());
    return clamped;
}

QEvent::Type focusRequestEventType()
{
    static const auto sType = QEvent::Type(QEvent::registerEventType());
    return sType;
}

} // namespace Velmar::Private

namespace Velmar {

Boolean IsValidWindowPtr(WindowRef window)
{
    return Private::isLive(window.get()) && !window->IsDeletePending();
}

} // namespace Velmar
