// The Window Manager: creating windows, their geometry and regions, the window list and its
// order, update regions, and hit testing.
#pragma once

#include <Velmar/MacTypes.h>
#include <Velmar/QDTypes.h>
#include <Velmar/WindowRef.h>

class QWidget;

namespace Velmar {

class IWindowEventHandler;

namespace Brindle {
class ManagedWindow;
}

using WindowClass = UInt32;
using WindowAttributes = UInt32;
using WindowRegionCode = UInt16;
using WindowPartCode = SInt16;
using PropertyCreator = OSType;
using PropertyTag = OSType;

enum : WindowClass {
    kAlertWindowClass = 1,
    kMovableAlertWindowClass = 2,
    kModalWindowClass = 3,
    kMovableModalWindowClass = 4,
    kFloatingWindowClass = 5,
    kDocumentWindowClass = 6,
    kUtilityWindowClass = 8,
    kHelpWindowClass = 10,
    kSheetWindowClass = 11,
    kToolbarWindowClass = 12,
    kPlainWindowClass = 13,
    kOverlayWindowClass = 14,
    kSheetAlertWindowClass = 15,
    kAltPlainWindowClass = 16,
};

enum : WindowAttributes {
    kWindowNoAttributes = 0,
    kWindowCloseBoxAttribute = 1u << 0,
    kWindowHorizontalZoomAttribute = 1u << 1,
    kWindowVerticalZoomAttribute = 1u << 2,
    kWindowFullZoomAttribute = kWindowHorizontalZoomAttribute | kWindowVerticalZoomAttribute,
    kWindowCollapseBoxAttribute = 1u << 3,
    kWindowResizableAttribute = 1u << 4,
    kWindowSideTitlebarAttribute = 1u << 5,
    kWindowNoTitleBarAttribute = 1u << 9,
    kWindowNoShadowAttribute = 1u << 21,
    kWindowHideOnSuspendAttribute = 1u << 24,
    kWindowStandardHandlerAttribute = 1u << 25,
    kWindowStandardDocumentAttributes = kWindowCloseBoxAttribute | kWindowFullZoomAttribute
        | kWindowCollapseBoxAttribute | kWindowResizableAttribute,
    kWindowStandardFloatingAttributes = kWindowCloseBoxAttribute | kWindowCollapseBoxAttribute,
};

enum : WindowRegionCode {
    kWindowTitleBarRgn = 0,
    kWindowTitleTextRgn = 1,
    kWindowCloseBoxRgn = 2,
    kWindowZoomBoxRgn = 3,
    kWindowDragRgn = 5,
    kWindowGrowRgn = 6,
    kWindowCollapseBoxRgn = 7,
    kWindowStructureRgn = 32,
    kWindowContentRgn = 33,
    kWindowUpdateRgn = 34,
    kWindowOpaqueRgn = 35,
    kWindowGlobalPortRgn = 40,
};

// FindWindow's answers and the zoom part codes. FindWindow answers only inDesk, inContent
// and inGrow: the frame around a window belongs to the window system or the UI shell.
enum : WindowPartCode {
    inDesk = 0,
    inNoWindow = 0,
    inMenuBar = 1,
    inSysWindow = 2,
    inContent = 3,
    inDrag = 4,
    inGrow = 5,
    inGoAway = 6,
    inZoomIn = 7,
    inZoomOut = 8,
    inCollapseBox = 11,
};

// ---- Creating and disposing ---------------------------------------------------------------
// `handler` is an IWindowEventHandler* (may be null: the window then makes update events).
VELMAR_EXPORT OSStatus CreateNewWindowEx(void* handler, WindowClass windowClass,
                                         WindowAttributes attributes, const Rect* bounds,
                                         WindowRef* outWindow);
VELMAR_EXPORT OSStatus CreateNewWindow(WindowClass windowClass, WindowAttributes attributes,
                                       const Rect* bounds, WindowRef* outWindow);
// `behind` is ignored: new windows open in front.
VELMAR_EXPORT WindowRef NewCWindow(void* handler, const Rect* bounds, ConstStr255Param title,
                                   Boolean visible, SInt16 procID, WindowRef behind,
                                   Boolean goAwayFlag, void* refCon);
VELMAR_EXPORT void DisposeWindow(WindowRef window);
// True for a window that is alive and not disposed; never asserts (any pointer may be asked).
VELMAR_EXPORT Boolean IsValidWindowPtr(WindowRef window);

// ---- Visibility, size and place ---------------------------------------------------------------
VELMAR_EXPORT void ShowWindow(WindowRef window);
VELMAR_EXPORT void HideWindow(WindowRef window);
VELMAR_EXPORT void ShowHide(WindowRef window, Boolean show);
VELMAR_EXPORT Boolean IsWindowVisible(WindowRef window);
// `fUpdate` is ignored.
VELMAR_EXPORT void SizeWindow(WindowRef window, SInt16 width, SInt16 height, Boolean fUpdate);
VELMAR_EXPORT void MoveWindow(WindowRef window, SInt16 h, SInt16 v, Boolean front);
VELMAR_EXPORT OSStatus SetWindowBounds(WindowRef window, WindowRegionCode regionCode,
                                       const Rect* globalBounds);
VELMAR_EXPORT OSStatus GetWindowBounds(WindowRef window, WindowRegionCode regionCode,
                                       Rect* globalBounds);
VELMAR_EXPORT OSStatus GetWindowRegion(WindowRef window, WindowRegionCode regionCode,
                                       RgnHandle region);
VELMAR_EXPORT void ZoomWindow(WindowRef window, WindowPartCode partCode, Boolean front);
// A modal rubber-band resize from `start`; the new content size as height << 16 | width.
// `sizeConstraints`: top and left are the minimum height and width, bottom and right the
// maximum.
VELMAR_EXPORT SInt32 GrowWindow(WindowRef window, Point start, const Rect* sizeConstraints);
VELMAR_EXPORT void SetWindowStandardState(WindowRef window, const Rect* rect);
VELMAR_EXPORT void SetWindowUserState(WindowRef window, const Rect* rect);
VELMAR_EXPORT Rect* GetWindowStandardState(WindowRef window, Rect* rect);
VELMAR_EXPORT Rect* GetWindowUserState(WindowRef window, Rect* rect);
// The outline of `region` follows the mouse until the button goes up; the offset moved as
// v << 16 | h, or 0x80008000 when released outside `slopRect`.
VELMAR_EXPORT SInt32 DragGrayRgn(RgnHandle region, Point start, const Rect* limitRect,
                                 const Rect* slopRect, SInt16 axis, void (*actionProc)());

// ---- Window state -----------------------------------------------------------------------------
VELMAR_EXPORT void SetWTitle(WindowRef window, ConstStr255Param title);
VELMAR_EXPORT void GetWTitle(WindowRef window, Str255 title);
VELMAR_EXPORT void SetWRefCon(WindowRef window, void* refCon);
VELMAR_EXPORT void* GetWRefCon(WindowRef window);
VELMAR_EXPORT void SetWindowKind(WindowRef window, SInt16 kind);
VELMAR_EXPORT SInt16 GetWindowKind(WindowRef window);
VELMAR_EXPORT SInt16 GetWVariant(WindowRef window);
VELMAR_EXPORT OSStatus GetWindowClass(WindowRef window, WindowClass* outClass);
VELMAR_EXPORT GrafPtr GetWindowPort(WindowRef window);
VELMAR_EXPORT void SetPortWindowPort(WindowRef window);
VELMAR_EXPORT Rect* GetWindowPortBounds(WindowRef window, Rect* bounds);
VELMAR_EXPORT WindowRef GetWindowFromPort(GrafPtr port);
VELMAR_EXPORT OSStatus SetWindowProperty(WindowRef window, PropertyCreator creator,
                                         PropertyTag tag, UInt32 size, const void* data);
VELMAR_EXPORT OSStatus GetWindowProperty(WindowRef window, PropertyCreator creator,
                                         PropertyTag tag, UInt32 bufferSize, UInt32* actualSize,
                                         void* buffer);
VELMAR_EXPORT OSStatus RemoveWindowProperty(WindowRef window, PropertyCreator creator,
                                            PropertyTag tag);
VELMAR_EXPORT OSStatus SetWindowContentColor(WindowRef window, const RGBColor* color);
VELMAR_EXPORT void HiliteWindow(WindowRef window, Boolean hilite);
VELMAR_EXPORT Boolean IsWindowHilited(WindowRef window);
VELMAR_EXPORT OSStatus ActivateWindow(WindowRef window, Boolean activate);

// ---- Update regions ---------------------------------------------------------------------------
VELMAR_EXPORT OSStatus InvalWindowRect(WindowRef window, const Rect* bounds);
VELMAR_EXPORT OSStatus InvalWindowRgn(WindowRef window, RgnHandle region);
VELMAR_EXPORT OSStatus ValidWindowRect(WindowRef window, const Rect* bounds);
VELMAR_EXPORT OSStatus ValidWindowRgn(WindowRef window, RgnHandle region);
VELMAR_EXPORT void BeginUpdate(WindowRef window);
VELMAR_EXPORT void EndUpdate(WindowRef window);
VELMAR_EXPORT Boolean IsWindowUpdatePending(WindowRef window);
// Copies every window's drawn area to the screen (at once, or at the next paint); true when
// a repaint was requested for later.
VELMAR_EXPORT bool RepaintDirtyPorts(bool immediately);

// ---- The window list and its order ------------------------------------------------------------
VELMAR_EXPORT WindowRef FrontWindow();
VELMAR_EXPORT WindowRef GetWindowList();
VELMAR_EXPORT WindowRef GetNextWindow(WindowRef window);
VELMAR_EXPORT void BringToFront(WindowRef window);
VELMAR_EXPORT void SendBehind(WindowRef window, WindowRef behindWindow);
VELMAR_EXPORT void SelectWindow(WindowRef window);
VELMAR_EXPORT OSStatus SetUserFocusWindow(WindowRef window);
VELMAR_EXPORT WindowRef GetUserFocusWindow();
VELMAR_EXPORT WindowPartCode FindWindow(Point point, WindowRef* window);
VELMAR_EXPORT void PaintOne(WindowRef window, RgnHandle clobbered);
VELMAR_EXPORT void PaintBehind(WindowRef startWindow, RgnHandle clobbered);
// Accepted and ignored: Qt works out what is visible.
VELMAR_EXPORT void CalcVisBehind(WindowRef startWindow, RgnHandle clobbered);
VELMAR_EXPORT void SyncUpdateEvent(WindowRef window, int mode);

// ---- Windows, widgets and native handles ------------------------------------------------------
VELMAR_EXPORT QWidget* GetWidgetPtr(WindowRef window);
VELMAR_EXPORT Brindle::ManagedWindow* GetManagedWindowPtr(WindowRef window);
VELMAR_EXPORT void* GetNativeWindowFromWidget(QWidget* widget);
VELMAR_EXPORT WindowRef GetWindowRefFromNative(void* handle);
VELMAR_EXPORT WindowRef GetWindowRefFromWidget(QWidget* widget, bool* isDynView);

// ---- The mouse in window terms ----------------------------------------------------------------
// The cursor in the current port's window widget, or global without a window port.
VELMAR_EXPORT void GetMouse(Point* where);

} // namespace Velmar
