/* Every classic header, included twice, in strict C. */
#include <ClassicToolbox.h>
#include <Types.h>
#include <MacTypes.h>
#include <Memory.h>
#include <OSUtils.h>
#include <Gestalt.h>
#include <ToolUtils.h>
#include <TextUtils.h>
#include <Packages.h>
#include <Quickdraw.h>
#include <QuickDraw.h>
#include <Fonts.h>
#include <Icons.h>
#include <Events.h>
#include <Controls.h>
#include <Windows.h>
#include <Menus.h>
#include <TextEdit.h>
#include <Resources.h>
#include <Dialogs.h>
#include <Sound.h>
#include <Devices.h>
#include <Traps.h>

/* The sizes code relies on: a window pointer is its port, a message holds a pointer. */
typedef char portFirst[(sizeof(WindowRecord) > sizeof(GrafPort)) ? 1 : -1];
typedef char messageHoldsPointer[(sizeof(((EventRecord*)0)->message) >= sizeof(void*)) ? 1 : -1];

int classicHeadersCompile(void)
{
    WindowRecord w;
    EventRecord e;
    w.refCon = 0;
    e.what = nullEvent;
    return (int)w.refCon + e.what;
}
