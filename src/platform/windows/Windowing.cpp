// Native windows on Windows: HWNDs, SetWindowPos and DIB-section back buffers.
#include "platform/windows/Win32.h"

#include "platform/Platform.h"

#include <QImage>
#include <QWidget>

namespace Velmar::Private::Platform {

namespace {

// Owned by the image: released when its last copy goes.
struct DibSection {
    HDC dc;
    HBITMAP bitmap;
    HGDIOBJ previous;
};

void releaseDibSection(void* info)
{
    auto* dib = static_cast<DibSection*>(info);
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

QImage createWindowImage(int width, int height)
{
    // Toolbox coordinates are 16-bit: nothing larger can be a window's content.
    if (width <= 0 || height <= 0 || width > 32767 || height > 32767) {
        if (width > 0 && height > 0)
            qWarning("createWindowImage: refused size %d x %d", width, height);
        return QImage();
    }

    BITMAPINFO info = {};
    info.bmiHeader.biSize = sizeof(BITMAPINFOHEADER);
    info.bmiHeader.biWidth = width;
    info.bmiHeader.biHeight = -height; // top-down, row 0 first, as QImage expects
    info.bmiHeader.biPlanes = 1;
    info.bmiHeader.biBitCount = 32;
    info.bmiHeader.biCompression = BI_RGB;

    HDC screen = GetDC(nullptr);
    HDC dc = CreateCompatibleDC(screen);
    ReleaseDC(nullptr, screen);
    if (!dc)
        return QImage(width, height, QImage::Format_ARGB32_Premultiplied);

    void* bits = nullptr;
    HBITMAP bitmap = CreateDIBSection(dc, &info, DIB_RGB_COLORS, &bits, nullptr, 0);
    if (!bitmap || !bits) {
        if (bitmap)
            DeleteObject(bitmap);
        DeleteDC(dc);
        return QImage(width, height, QImage::Format_ARGB32_Premultiplied);
    }
    auto* dib = new DibSection{dc, bitmap, SelectObject(dc, bitmap)};
    GdiFlush();
    return QImage(static_cast<uchar*>(bits), width, height, width * 4,
                  QImage::Format_ARGB32_Premultiplied, releaseDibSection, dib);
}

} // namespace Velmar::Private::Platform
