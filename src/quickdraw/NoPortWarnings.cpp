// What each call logs when there is no current port. The wordings differ from call to call
// and hosts' log filters match them, so they are kept exactly, in one table.
#include "quickdraw/CurrentPort.h"

#include <Velmar/Diagnostics.h>

#include <cstring>

namespace Velmar::Private {

namespace {

// Printf formats taking the call's name; a row without %s is logged as it stands.
constexpr const char* kCantGetSpaced = "warning: %s: Can't get current port !";
constexpr const char* kCantGet = "warning: %s: Can't get current port!";
constexpr const char* kCannotGet = "warning: %s: cannot get current port";
constexpr const char* kCannotGetQt = "warning: %s: cannot get Qt port";

struct NoPortWarning {
    const char* call;
    const char* format;
};

// Calls not listed take kCantGet, the wording of the painter every drawing call asks for.
constexpr NoPortWarning kWarnings[] = {
    // The pen and its state.
    {"PenPat", kCantGetSpaced},
    {"BackPat", kCantGetSpaced},
    {"PenSize", kCantGetSpaced},
    {"PenMode", kCantGetSpaced},
    {"PenNormal", kCantGetSpaced},
    {"HidePen", kCantGetSpaced},
    {"ShowPen", kCantGetSpaced},
    {"GetPen", kCantGetSpaced},
    {"SetPenStyle", kCantGetSpaced},
    {"GetPenStyle", kCantGetSpaced},
    {"GetPenState", kCantGetSpaced},
    {"SetPenState", kCantGetSpaced},
    {"GetBackColor", kCantGetSpaced},
    {"Velmar::TextMode", kCantGetSpaced},
    {"TextFont", kCantGetSpaced},
    {"TextSize", kCantGetSpaced},
    {"TextFace", kCantGetSpaced},
    // Frames, lines, recording and clip.
    {"FrameRect", kCannotGet},
    {"FrameOval", kCannotGet},
    {"FrameRoundRect", kCannotGet},
    {"FramePoly", kCannotGet},
    {"FrameRgn", kCannotGet},
    {"ClosePoly", kCannotGet},
    {"StdRect", kCannotGet},
    {"MoveTo", kCannotGet},
    {"Move", kCannotGet},
    {"LineTo", kCannotGet},
    {"Line", kCannotGet},
    {"OpenRgn", kCannotGet},
    {"CloseRgn", kCannotGet},
    {"GetClip", kCannotGet},
    {"SetClip", kCannotGet},
    {"ClipRect", kCannotGet},
    {"DragGrayRgn", kCannotGet},
    {"MeasureText", kCannotGet},
    {"TextWidthInternal", kCannotGet},
    {"GetFontInfo", kCannotGet},
    // Pixels and the point-list line calls (both of which log under the first one's name).
    {"DrawLinesFromPointPairs", kCannotGetQt},
    {"GetPortPenLocation", kCannotGetQt},
    {"GetPortPenMode", kCannotGetQt},
    {"GetPortTextFont", kCannotGetQt},
    {"GetPortTextSize", kCannotGetQt},
    {"GetPortTextFace", kCannotGetQt},
    {"GetPortTextMode", kCannotGetQt},
    {"SetCPixel", kCannotGetQt},
    {"GetCPixel", kCannotGetQt},
    // Wordings of their own.
    {"OpColor", "OpColor: Can't get port"},
    {"PortSize", "PortSize: current port is NULL"},
    {"SetOrigin", "SetOrigin: currentGrafPort = NULL"},
};

const char* formatFor(const char* call)
{
    for (const NoPortWarning& row : kWarnings) {
        if (std::strcmp(row.call, call) == 0)
            return row.format;
    }
    return kCantGet;
}

} // namespace

void warnNoCurrentPort(const char* call)
{
    if (!call)
        call = "";
    const char* format = formatFor(call);
    if (std::strstr(format, "%s"))
        VelmarLog(kLogQuickDraw, format, call); // NOLINT: formats come from the table above
    else
        VelmarLog(kLogQuickDraw, "%s", format);
}

} // namespace Velmar::Private
