// The default decoration manager: leaves frames to the window system. Hosts with a shell
// install a factory so that the application creates theirs instead.
#include <Velmar/HostShell.h>

#include "host/FrameDecorator.h"
#include "host/Replaceable.h"

namespace Velmar::Brindle {

namespace {

DecorationManager* defaultFactory(QMenuBar* menuBar, int mdiMode)
{
    return new DecorationManager(menuBar, mdiMode);
}

Private::Replaceable<DecorationManager::Factory> gFactory(defaultFactory);
DecorationManager* gCurrent = nullptr;

} // namespace

DecorationManager::DecorationManager(QMenuBar* menuBar, int mdiMode)
    : m_menuBar(menuBar), m_mdiMode(mdiMode), m_previous(gCurrent)
{
    gCurrent = this;
}

DecorationManager::~DecorationManager()
{
    if (gCurrent == this)
        gCurrent = m_previous;
}

// Decorated mode draws the shell's own frame; native mode leaves it to the window system.
void DecorationManager::Decorate(ManagedWindow* window)
{
    if (!window || m_mdiMode != kMdiDecorated || window->GetDecorator() || !window->GetWidget())
        return;
    window->SetDecorator(new FrameDecorator(window));
}

void DecorationManager::Undecorate(ManagedWindow* window)
{
    if (!window)
        return;
    Decorator* decorator = window->GetDecorator();
    window->SetDecorator(nullptr);
    delete decorator;
}

QWidget* DecorationManager::HiddenDefaultParent() const
{
    return nullptr;
}

DecorationManager* DecorationManager::Instance()
{
    return gCurrent;
}

QWidget* DecorationManager::GetHiddenDefaultParent()
{
    return gCurrent ? gCurrent->HiddenDefaultParent() : nullptr;
}

DecorationManager* DecorationManager::Create(QMenuBar* menuBar, int mdiMode)
{
    return gFactory.get()(menuBar, mdiMode);
}

DecorationManager::Factory DecorationManager::SetFactory(Factory factory)
{
    return gFactory.set(factory);
}

} // namespace Velmar::Brindle
