// Native windows on Windows: HWNDs, SetWindowPos and DIB-section back buffers.
#include "platform/windows/Win32.h"

#include "platform/Platform.h"

#include <QImage>
#include <QWidget>

#include <map>

namespace Velmar::Private::Platform {

namespace {

// Owned by the image: released when its last copy goes.
struct DibSection {
    HDC dc;
    HBITMAP bitmap;
    HGDIOBJ previous;
};

// The device context of each live DIB section, by its pixel memory (GUI thread only).
std::map<const void*, HDC>& contexts()
{
    static std::map<const void*, HDC> sContexts;
    return sContexts;
}

struct DibRelease {
    DibSection* dib;
    const void* bits;
};

void releaseDibSection(void* info)
{
    auto* release = static_cast<DibRelease*>(info);
    contexts().erase(release->bits);
    DibSection* dib = release->dib;
    delete release;
    SelectObject(dib->dc, dib->previous);
    DeleteDC(dib->dc);
    DeleteObject(dib->bitmap);
    delete dib;
}

HWND handleOf(QWidget* widget)
{
    return widget ? reinterpret_cast<HWND>(widget->winId()) : nullptr;
}

} // namespace

void* nativeWindowHandle(QWidget* window)
{
    return handleOf(window);
}

void placeNativeWindowBehind(QWidget* window, QWidget* behind)
{
    // The historical call positions `behind` relative to itself, which leaves the native
    // stacking as it is; the window list and the z-order change event carry the order.
    const HWND target = behind ? handleOf(behind) : handleOf(window);
    if (!target)
        return;
    const HWND insertAfter = behind ? target : HWND_BOTTOM;
    SetWindowPos(target, insertAfter, 0, 0, 0, 0, SWP_NOSIZE | SWP_NOMOVE | SWP_NOACTIVATE);
}

// The strip is a topmost window; Windows keeps work-area reservations for application
// desktop toolbars, which the menu bar is not.
void reserveScreenTop(QWidget*, int) {}

QImage createWindowImage(int width, int height, QImage::Format format)
{
    const bool rgb16 = format == QImage::Format_RGB16;
    // Toolbox coordinates are 16-bit: nothing larger can be a window's content.
    if (width <= 0 || height <= 0 || width > 32767 || height > 32767) {
        if (width > 0 && height > 0)
            qWarning("createWindowImage: refused size %d x %d", width, height);
        return QImage();
    }

    // Room for the three 5-6-5 masks after the header.
    struct {
        BITMAPINFOHEADER header;
        DWORD masks[3];
    } info = {};
    info.header.biSize = sizeof(BITMAPINFOHEADER);
    info.header.biWidth = width;
    info.header.biHeight = -height; // top-down, row 0 first, as QImage expects
    info.header.biPlanes = 1;
    info.header.biBitCount = rgb16 ? 16 : 32;
    info.header.biCompression = rgb16 ? BI_BITFIELDS : BI_RGB;
    info.masks[0] = 0xF800;
    info.masks[1] = 0x07E0;
    info.masks[2] = 0x001F;
    const QImage::Format qtFormat = rgb16 ? QImage::Format_RGB16 : QImage::Format_ARGB32_Premultiplied;

    HDC screen = GetDC(nullptr);
    HDC dc = CreateCompatibleDC(screen);
    ReleaseDC(nullptr, screen);
    if (!dc)
        return QImage(width, height, qtFormat);

    void* bits = nullptr;
    HBITMAP bitmap = CreateDIBSection(dc, reinterpret_cast<BITMAPINFO*>(&info), DIB_RGB_COLORS,
                                      &bits, nullptr, 0);
    if (!bitmap || !bits) {
        if (bitmap)
            DeleteObject(bitmap);
        DeleteDC(dc);
        return QImage(width, height, qtFormat);
    }
    auto* dib = new DibSection{dc, bitmap, SelectObject(dc, bitmap)};
    GdiFlush();
    contexts()[bits] = dc;
    const int bytesPerLine = rgb16 ? ((width * 2 + 3) & ~3) : width * 4;
    return QImage(static_cast<uchar*>(bits), width, height, bytesPerLine, qtFormat,
                  releaseDibSection, new DibRelease{dib, bits});
}

void* windowImageDeviceContext(const QImage& image)
{
    auto it = contexts().find(image.constBits());
    return it == contexts().end() ? nullptr : it->second;
}

} // namespace Velmar::Private::Platform
