#include "DemoText.h"

#include "DemoDesktop.h"

#include <QByteArray>

using namespace Velmar;

namespace Demo {

namespace {

constexpr SInt16 kColourMenuID = 140;
const Rect kPopUp{420, 20, 440, 190};

WindowRef gTextWindow;
MenuRef gColourMenu;

struct NamedColour {
    const char* name;
    RGBColor colour;
};
const NamedColour kColours[] = {
    {"Black", RGBColor(0, 0, 0)},
    {"Red", RGBColor(0xCCCC, 0x1111, 0x1111)},
    {"Green", RGBColor(0x1111, 0x8888, 0x2222)},
    {"Blue", RGBColor(0x1111, 0x3333, 0xCCCC)},
};

void drawLine(SInt16 h, SInt16 v, const QByteArray& text)
{
    MoveTo(h, v);
    Str255 pascal;
    QString2PascalString(QString::fromLatin1(text), pascal);
    DrawString(pascal);
}

void setFont(SInt16 font, SInt16 size, SInt16 face)
{
    TextFont(font, false);
    TextSize(size, false);
    TextFace(face, false);
}

// Rows of fonts, sizes and faces, each line measured to show StringWidth at work.
void drawSamples()
{
    const RGBColor black(0, 0, 0);
    RGBForeColor(&black);
    struct Row {
        SInt16 font;
        const char* name;
    };
    const Row rows[] = {{geneva, "geneva"}, {newYork, "newYork"}, {monaco, "monaco"}};
    const SInt16 sizes[] = {9, 12, 18};
    SInt16 v = 30;
    for (const Row& row : rows) {
        SInt16 h = 20;
        for (SInt16 size : sizes) {
            setFont(row.font, size, normal);
            const QByteArray text = QByteArray(row.name) + " " + QByteArray::number(size);
            drawLine(h, v, text);
            h = SInt16(h + 40
                + StringWidth(reinterpret_cast<const unsigned char*>(
                    (char(text.size()) + text).constData())));
        }
        v = SInt16(v + 30);
    }
    const struct {
        SInt16 face;
        const char* name;
    } faces[] = {{normal, "plain"}, {bold, "bold"}, {italic, "italic"}, {underline, "underline"},
        {bold | italic, "bold italic"}};
    SInt16 h = 20;
    for (const auto& f : faces) {
        setFont(geneva, 14, f.face);
        drawLine(h, v, f.name);
        Point pen;
        GetPen(&pen);
        h = SInt16(pen.h + 20);
    }
}

// Icons and the picture of the demo's resource file (family 128: colour, 129: black and
// white, 130: 8-bit), and the style's stop, note and caution icons.
void drawIcons()
{
    SInt16 left = 20;
    const SInt16 top = 170;
    ResourceHandle colour = GetCIcon(128);
    Rect r{top, left, SInt16(top + 32), SInt16(left + 32)};
    PlotCIcon(&r, colour);
    ReleaseResource(colour);
    left = SInt16(left + 44);
    for (SInt16 id = 0; id <= 2; ++id, left = SInt16(left + 44)) {
        ResourceHandle alert = GetCIcon(id);
        r = Rect{top, left, SInt16(top + 32), SInt16(left + 32)};
        PlotCIcon(&r, alert);
        ReleaseResource(alert);
    }
    // The black-and-white icon takes the foreground colour; small rectangles take the small
    // member of the family.
    for (const NamedColour& c : kColours) {
        RGBForeColor(&c.colour);
        r = Rect{top, left, SInt16(top + 32), SInt16(left + 32)};
        PlotIconID(&r, 0, 0, 129);
        left = SInt16(left + 40);
    }
    r = Rect{SInt16(top + 8), left, SInt16(top + 24), SInt16(left + 16)};
    PlotIconID(&r, 0, 0, 128);
    left = SInt16(left + 28);
    r = Rect{top, left, SInt16(top + 32), SInt16(left + 32)};
    PlotIconID(&r, 0, 0, 130);

    ResourceHandle picture = GetPicture(128);
    const Rect frame{220, 20, 340, 260};
    DrawPicture(picture, &frame);
    const Rect half{220, 280, 280, 400}; // the same picture at half its size
    DrawPicture(picture, &half);
    ReleaseResource(picture);
}

// The 'TEXT' resource, as bytes of a memory handle.
void drawTextResource()
{
    ResourceHandle text = GetResource(FOUR_CHAR_CODE("TEXT"), 128);
    setFont(newYork, 12, italic);
    const RGBColor grey(0x4444, 0x4444, 0x4444);
    RGBForeColor(&grey);
    MoveTo(20, 365);
    if (!text.isNull()) {
        Handle bytes = static_cast<Handle>(text.data());
        DrawText(*bytes, 0, SInt16(TxGetHandleSize(bytes)));
    }
    ReleaseResource(text);
}

void drawSample()
{
    TextSample& s = textSample();
    setFont(s.font, s.size, s.face);
    RGBForeColor(&s.colour);
    drawLine(20, 405, "The quick brown fox jumps over the lazy dog");
}

void drawPopUp()
{
    const RGBColor black(0, 0, 0);
    RGBForeColor(&black);
    setFont(geneva, 12, normal);
    FrameRect(&kPopUp);
    const Rect shadow{SInt16(kPopUp.bottom), SInt16(kPopUp.left + 2), SInt16(kPopUp.bottom + 1),
        SInt16(kPopUp.right + 1)};
    PaintRect(&shadow);
    QByteArray name = "Colour: ";
    for (const NamedColour& c : kColours)
        if (c.colour.red == textSample().colour.red && c.colour.green == textSample().colour.green
            && c.colour.blue == textSample().colour.blue)
            name += c.name;
    drawLine(SInt16(kPopUp.left + 8), SInt16(kPopUp.bottom - 5), name);
    // The pop-up's triangle.
    PolyPtr* triangle = OpenPoly();
    MoveTo(SInt16(kPopUp.right - 18), SInt16(kPopUp.top + 7));
    LineTo(SInt16(kPopUp.right - 8), SInt16(kPopUp.top + 7));
    LineTo(SInt16(kPopUp.right - 13), SInt16(kPopUp.top + 13));
    LineTo(SInt16(kPopUp.right - 18), SInt16(kPopUp.top + 7));
    ClosePoly();
    PaintPoly(triangle);
    KillPoly(triangle);
}

} // namespace

TextSample& textSample()
{
    static TextSample sSample;
    return sSample;
}

WindowRef openTextWindow()
{
    if (gTextWindow && IsValidWindowPtr(gTextWindow)) {
        SelectWindow(gTextWindow);
        return gTextWindow;
    }
    const Rect bounds{60, 420, 520, 1000};
    gTextWindow = NewCWindow(nullptr, &bounds,
        reinterpret_cast<const unsigned char*>("\x0D"
                                               "Fonts & Icons"),
        true, 0, nullptr, true, nullptr);
    if (!gColourMenu) {
        gColourMenu = NewMenu(kColourMenuID,
            reinterpret_cast<const unsigned char*>("\x06"
                                                   "Colour"));
        AppendMenu(gColourMenu,
            reinterpret_cast<const unsigned char*>("\x16"
                                                   "Black;Red;Green;Blue"));
        InsertMenu(gColourMenu, -1); // a pop-up: listed, not in the bar
    }
    return gTextWindow;
}

bool isTextWindow(WindowRef window)
{
    return window && window == gTextWindow;
}

void drawTextWindow(WindowRef window)
{
    Rect all;
    GetWindowPortBounds(window, &all);
    const RGBColor white(0xFFFF, 0xFFFF, 0xFFFF);
    RGBBackColor(&white);
    EraseRect(&all);
    drawSamples();
    drawIcons();
    drawTextResource();
    drawSample();
    drawPopUp();
    drawDesktopBoxes();
}

bool clickTextWindow(WindowRef window, Point where)
{
    SetPortWindowPort(window);
    Point local = where;
    GlobalToLocal(&local);
    if (!PtInRect(local, &kPopUp))
        return false;
    int current = 1;
    for (int i = 0; i < 4; ++i)
        if (kColours[i].colour.red == textSample().colour.red
            && kColours[i].colour.blue == textSample().colour.blue
            && kColours[i].colour.green == textSample().colour.green)
            current = i + 1;
    Point corner{kPopUp.top, kPopUp.left};
    LocalToGlobal(&corner);
    const SInt32 choice = PopUpMenuSelect(gColourMenu, corner.v, corner.h, UInt16(current));
    const int item = choice & 0xFFFF;
    if (item >= 1 && item <= 4) {
        textSample().colour = kColours[item - 1].colour;
        invalidateTextWindow();
    }
    return true;
}

void invalidateTextWindow()
{
    if (!gTextWindow || !IsValidWindowPtr(gTextWindow))
        return;
    Rect all;
    GetWindowPortBounds(gTextWindow, &all);
    InvalWindowRect(gTextWindow, &all);
}

} // namespace Demo
