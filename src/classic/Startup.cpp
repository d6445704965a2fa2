// The start of a classic program: the QuickDraw globals, the Init… calls, the application
// object the library needs (made on first use: classic programs never make one) and leaving.
#include "classic/ClassicPrivate.h"

#include <QCoreApplication>
#include <QGuiApplication>
#include <QScreen>

#include <cstddef>
#include <cstdlib>
#include <cstring>
#include <fstream>
#include <string>

// The globals a program sees: qd (unless it defines its own), and the plain names older
// compilers gave.
QDGlobals qd;
GrafPtr thePort = nullptr;
long randSeed = 1;

namespace VelmarClassic {

namespace {

QDGlobals* gGlobals = &qd;

// Qt keeps argc and argv for the application's life.
int gArgc = 1;
std::string gProgramName = "classic";
char* gArgv[2] = {nullptr, nullptr};

void fillPattern(Pattern& p, UInt8 even, UInt8 odd)
{
    for (int i = 0; i < 8; ++i)
        p.pat[i] = (i % 2) ? odd : even;
}

void fillGlobals(QDGlobals& g)
{
    fillPattern(g.white, 0x00, 0x00);
    fillPattern(g.black, 0xFF, 0xFF);
    fillPattern(g.gray, 0xAA, 0x55);
    fillPattern(g.ltGray, 0x88, 0x22);
    fillPattern(g.dkGray, 0x77, 0xDD);
    // The arrow: its outline as the mask, the arrow itself as the data.
    static const unsigned short arrowData[16] = {0x0000, 0x4000, 0x6000, 0x7000, 0x7800, 0x7C00,
        0x7E00, 0x7F00, 0x7F80, 0x7C00, 0x6C00, 0x4600, 0x0600, 0x0300, 0x0300, 0x0000};
    static const unsigned short arrowMask[16] = {0xC000, 0xE000, 0xF000, 0xF800, 0xFC00, 0xFE00,
        0xFF00, 0xFF80, 0xFFC0, 0xFFE0, 0xFE00, 0xEF00, 0xCF00, 0x0780, 0x0780, 0x0380};
    for (int i = 0; i < 16; ++i) {
        g.arrow.data[i] = short(arrowData[i]);
        g.arrow.mask[i] = short(arrowMask[i]);
    }
    g.arrow.hotSpot = Point{1, 1};
    g.randSeed = 1;
    g.thePort = nullptr;
}

void readProgramName()
{
    std::ifstream cmdline("/proc/self/cmdline", std::ios::binary);
    std::string first;
    if (cmdline && std::getline(cmdline, first, '\0') && !first.empty())
        gProgramName = first;
    gArgv[0] = gProgramName.data();
}

void fillScreenBits(QDGlobals& g)
{
    QScreen* screen = QGuiApplication::primaryScreen();
    const QRect r = screen ? screen->geometry() : QRect(0, 0, 640, 480);
    g.screenBits.baseAddr = nullptr;
    g.screenBits.rowBytes = short(((r.width() + 15) / 16) * 2);
    g.screenBits.bounds =
        Rect{short(r.top()), short(r.left()), short(r.bottom() + 1), short(r.right() + 1)};
}

} // namespace

QDGlobals* globals()
{
    return gGlobals;
}

void openProgramResources();

void ensureStarted()
{
    static bool started = false;
    if (started)
        return;
    started = true;
    if (!QCoreApplication::instance()) {
        readProgramName();
        // Native frames: the window system's close boxes, title bars and zoom buttons, whose
        // clicks the layer hands to the program as classic mouse-downs.
        new Velmar::AQtApplication(gArgc, gArgv, false);
    }
    fillScreenBits(*gGlobals);
    openProgramResources();
    watchMenuBar();
}

} // namespace VelmarClassic

using namespace VelmarClassic;

void InitGraf(void* globalPtr)
{
    // Programs pass &qd.thePort: the globals in use are the record around it.
    if (globalPtr)
        VelmarClassic::gGlobals = reinterpret_cast<QDGlobals*>(
            static_cast<char*>(globalPtr) - offsetof(QDGlobals, thePort));
    fillGlobals(*globals());
    randSeed = globals()->randSeed;
    thePort = nullptr;
    ensureStarted();
}

void InitFonts()
{
    ensureStarted();
}
void InitWindows()
{
    ensureStarted();
}
void InitMenus()
{
    ensureStarted();
}
void TEInit()
{
    ensureStarted();
}
void InitDialogs(void*)
{
    ensureStarted();
}
void MaxApplZone()
{}
void MoreMasters()
{}
void SetApplLimit(void*)
{}
Ptr GetApplLimit()
{
    return nullptr;
}

void ExitToShell()
{
    std::exit(0);
}
