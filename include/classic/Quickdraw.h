/* QuickDraw: ports and their records, pens, patterns and colours, shapes, regions, text,
   cursors, pictures and the QuickDraw globals. */
#ifndef VELMAR_CLASSIC_QUICKDRAW_H
#define VELMAR_CLASSIC_QUICKDRAW_H
#include "Types.h"
VELMAR_CLASSIC_BEGIN

enum {
    srcCopy = 0, srcOr = 1, srcXor = 2, srcBic = 3,
    notSrcCopy = 4, notSrcOr = 5, notSrcXor = 6, notSrcBic = 7,
    patCopy = 8, patOr = 9, patXor = 10, patBic = 11,
    notPatCopy = 12, notPatOr = 13, notPatXor = 14, notPatBic = 15
};
enum {
    normal = 0, bold = 1, italic = 2, underline = 4, outline = 8, shadow = 16,
    condense = 32, extend = 64
};
/* The classic colours, as ForeColor and BackColor take them. */
enum {
    blackColor = 33, whiteColor = 30, redColor = 205, greenColor = 341, blueColor = 409,
    cyanColor = 273, magentaColor = 137, yellowColor = 69
};

typedef struct Pattern {
    UInt8 pat[8];
} Pattern;
typedef const Pattern* ConstPatternParam;
typedef Pattern* PatPtr;
typedef PatPtr* PatHandle;
typedef short Bits16[16];

typedef struct BitMap {
    Ptr baseAddr;
    short rowBytes;
    Rect bounds;
} BitMap;
typedef BitMap* BitMapPtr;

typedef struct Cursor {
    Bits16 data;
    Bits16 mask;
    Point hotSpot;
} Cursor;
typedef Cursor* CursPtr;
typedef CursPtr* CursHandle;

typedef struct RGBColor {
    unsigned short red;
    unsigned short green;
    unsigned short blue;
} RGBColor;

typedef struct Region {
    unsigned short rgnSize; /* 10 for a rectangle */
    Rect rgnBBox;
} Region;
typedef Region* RgnPtr;
typedef RgnPtr* RgnHandle;

typedef struct Polygon {
    unsigned short polySize;
    Rect polyBBox;
    Point polyPoints[1];
} Polygon;
typedef Polygon* PolyPtr;
typedef PolyPtr* PolyHandle;

typedef struct Picture {
    unsigned short picSize;
    Rect picFrame;
} Picture;
typedef Picture* PicPtr;
typedef PicPtr* PicHandle;

typedef struct PixMap {
    Ptr baseAddr;
    short rowBytes;
    Rect bounds;
    short pmVersion;
    short packType;
    long packSize;
    Fixed hRes;
    Fixed vRes;
    short pixelType;
    short pixelSize;
    short cmpCount;
    short cmpSize;
    long planeBytes;
    Handle pmTable;
    long pmReserved;
} PixMap;
typedef PixMap* PixMapPtr;
typedef PixMapPtr* PixMapHandle;

typedef struct FontInfo {
    short ascent;
    short descent;
    short widMax;
    short leading;
} FontInfo;

typedef struct PenState {
    Point pnLoc;
    Point pnSize;
    short pnMode;
    Pattern pnPat;
} PenState;

typedef struct QDProcs* QDProcsPtr;

/* A port. The colour port below keeps every shared field at the same place, so either record
   may be read through the other's pointer. */
typedef struct GrafPort {
    short device;
    BitMap portBits;
    Rect portRect;
    RgnHandle visRgn;
    RgnHandle clipRgn;
    Pattern bkPat;
    Pattern fillPat;
    Point pnLoc;
    Point pnSize;
    short pnMode;
    Pattern pnPat;
    short pnVis;
    short txFont;
    Style txFace;
    char filler;
    short txMode;
    short txSize;
    Fixed spExtra;
    long fgColor;
    long bkColor;
    short colrBit;
    short patStretch;
    Handle picSave;
    Handle rgnSave;
    Handle polySave;
    QDProcsPtr grafProcs;
    short reservedColor[6];
    Handle reservedPixPat;
} GrafPort;
typedef GrafPort* GrafPtr;

typedef struct CGrafPort {
    short device;
    PixMapHandle portPixMap;
    short portVersion;
    short chExtra;
    short pnLocHFrac;
    Handle grafVars;
    Rect portRect;
    RgnHandle visRgn;
    RgnHandle clipRgn;
    Handle bkPixPat;
    Handle fillPixPat;
    Point pnLoc;
    Point pnSize;
    short pnMode;
    short pnPatReserved[4];
    short pnVis;
    short txFont;
    Style txFace;
    char filler;
    short txMode;
    short txSize;
    Fixed spExtra;
    long fgColor;
    long bkColor;
    short colrBit;
    short patStretch;
    Handle picSave;
    Handle rgnSave;
    Handle polySave;
    QDProcsPtr grafProcs;
    RGBColor rgbFgColor;
    RGBColor rgbBkColor;
    Handle pnPixPat;
} CGrafPort;
typedef CGrafPort* CGrafPtr;
typedef CGrafPtr GWorldPtr;

typedef struct QDGlobals {
    char privates[76];
    long randSeed;
    BitMap screenBits;
    Cursor arrow;
    Pattern dkGray;
    Pattern ltGray;
    Pattern gray;
    Pattern black;
    Pattern white;
    GrafPtr thePort;
} QDGlobals;

/* The globals. A program may define qd itself; InitGraf(&qd.thePort) names the one in use.
   thePort and randSeed are the plain globals of older compilers, kept equal to qd's. */
extern VELMAR_CLASSIC_API QDGlobals qd;
extern VELMAR_CLASSIC_API GrafPtr thePort;
extern VELMAR_CLASSIC_API long randSeed;

VELMAR_CLASSIC_API void InitGraf(void* globalPtr);
VELMAR_CLASSIC_API void OpenPort(GrafPtr port);
VELMAR_CLASSIC_API void InitPort(GrafPtr port);
VELMAR_CLASSIC_API void ClosePort(GrafPtr port);
VELMAR_CLASSIC_API void SetPort(GrafPtr port);
VELMAR_CLASSIC_API void GetPort(GrafPtr* port);
VELMAR_CLASSIC_API void SetOrigin(short h, short v);
VELMAR_CLASSIC_API void PortSize(short width, short height);
VELMAR_CLASSIC_API void SetClip(RgnHandle rgn);
VELMAR_CLASSIC_API void GetClip(RgnHandle rgn);
VELMAR_CLASSIC_API void ClipRect(const Rect* r);
VELMAR_CLASSIC_API void GlobalToLocal(Point* pt);
VELMAR_CLASSIC_API void LocalToGlobal(Point* pt);
VELMAR_CLASSIC_API long Random(void);
VELMAR_CLASSIC_API Boolean GetPixel(short h, short v);

VELMAR_CLASSIC_API void HidePen(void);
VELMAR_CLASSIC_API void ShowPen(void);
VELMAR_CLASSIC_API void GetPen(Point* pt);
VELMAR_CLASSIC_API void GetPenState(PenState* pnState);
VELMAR_CLASSIC_API void SetPenState(const PenState* pnState);
VELMAR_CLASSIC_API void PenSize(short width, short height);
VELMAR_CLASSIC_API void PenMode(short mode);
VELMAR_CLASSIC_API void PenPat(const Pattern* pat);
VELMAR_CLASSIC_API void PenNormal(void);
VELMAR_CLASSIC_API void BackPat(const Pattern* pat);
VELMAR_CLASSIC_API void ForeColor(long color);
VELMAR_CLASSIC_API void BackColor(long color);
VELMAR_CLASSIC_API void RGBForeColor(const RGBColor* color);
VELMAR_CLASSIC_API void RGBBackColor(const RGBColor* color);
VELMAR_CLASSIC_API void GetForeColor(RGBColor* color);
VELMAR_CLASSIC_API void GetBackColor(RGBColor* color);

VELMAR_CLASSIC_API void MoveTo(short h, short v);
VELMAR_CLASSIC_API void Move(short dh, short dv);
VELMAR_CLASSIC_API void LineTo(short h, short v);
VELMAR_CLASSIC_API void Line(short dh, short dv);

VELMAR_CLASSIC_API void SetRect(Rect* r, short left, short top, short right, short bottom);
VELMAR_CLASSIC_API void OffsetRect(Rect* r, short dh, short dv);
VELMAR_CLASSIC_API void InsetRect(Rect* r, short dh, short dv);
VELMAR_CLASSIC_API Boolean SectRect(const Rect* a, const Rect* b, Rect* dst);
VELMAR_CLASSIC_API void UnionRect(const Rect* a, const Rect* b, Rect* dst);
VELMAR_CLASSIC_API Boolean PtInRect(Point pt, const Rect* r);
VELMAR_CLASSIC_API Boolean EqualRect(const Rect* a, const Rect* b);
VELMAR_CLASSIC_API Boolean EmptyRect(const Rect* r);
VELMAR_CLASSIC_API void Pt2Rect(Point a, Point b, Rect* dst);
VELMAR_CLASSIC_API void SetPt(Point* pt, short h, short v);
VELMAR_CLASSIC_API Boolean EqualPt(Point a, Point b);
VELMAR_CLASSIC_API void AddPt(Point src, Point* dst);
VELMAR_CLASSIC_API void SubPt(Point src, Point* dst);

VELMAR_CLASSIC_API void FrameRect(const Rect* r);
VELMAR_CLASSIC_API void PaintRect(const Rect* r);
VELMAR_CLASSIC_API void EraseRect(const Rect* r);
VELMAR_CLASSIC_API void InvertRect(const Rect* r);
VELMAR_CLASSIC_API void FillRect(const Rect* r, const Pattern* pat);
VELMAR_CLASSIC_API void FrameOval(const Rect* r);
VELMAR_CLASSIC_API void PaintOval(const Rect* r);
VELMAR_CLASSIC_API void EraseOval(const Rect* r);
VELMAR_CLASSIC_API void InvertOval(const Rect* r);
VELMAR_CLASSIC_API void FillOval(const Rect* r, const Pattern* pat);
VELMAR_CLASSIC_API void FrameRoundRect(const Rect* r, short ovalWidth, short ovalHeight);
VELMAR_CLASSIC_API void PaintRoundRect(const Rect* r, short ovalWidth, short ovalHeight);
VELMAR_CLASSIC_API void EraseRoundRect(const Rect* r, short ovalWidth, short ovalHeight);
VELMAR_CLASSIC_API void InvertRoundRect(const Rect* r, short ovalWidth, short ovalHeight);
VELMAR_CLASSIC_API void FillRoundRect(const Rect* r, short ovalWidth, short ovalHeight,
                                      const Pattern* pat);
VELMAR_CLASSIC_API void FrameArc(const Rect* r, short startAngle, short arcAngle);
VELMAR_CLASSIC_API void PaintArc(const Rect* r, short startAngle, short arcAngle);
VELMAR_CLASSIC_API void EraseArc(const Rect* r, short startAngle, short arcAngle);
VELMAR_CLASSIC_API void InvertArc(const Rect* r, short startAngle, short arcAngle);
VELMAR_CLASSIC_API void FillArc(const Rect* r, short startAngle, short arcAngle,
                                const Pattern* pat);
VELMAR_CLASSIC_API PolyHandle OpenPoly(void);
VELMAR_CLASSIC_API void ClosePoly(void);
VELMAR_CLASSIC_API void KillPoly(PolyHandle poly);
VELMAR_CLASSIC_API void OffsetPoly(PolyHandle poly, short dh, short dv);
VELMAR_CLASSIC_API void FramePoly(PolyHandle poly);
VELMAR_CLASSIC_API void PaintPoly(PolyHandle poly);
VELMAR_CLASSIC_API void ErasePoly(PolyHandle poly);
VELMAR_CLASSIC_API void InvertPoly(PolyHandle poly);
VELMAR_CLASSIC_API void FillPoly(PolyHandle poly, const Pattern* pat);
VELMAR_CLASSIC_API void ScrollRect(const Rect* r, short dh, short dv, RgnHandle updateRgn);

/* Bitmaps: a port's portBits (a window's, or a port on the program's own bitmap), the
   screen (qd.screenBits) or a BitMap over the program's memory (1 bit a pixel, set = black). */
VELMAR_CLASSIC_API void SetPortBits(const BitMap* bm);
VELMAR_CLASSIC_API void CopyBits(const BitMap* srcBits, const BitMap* dstBits, const Rect* srcRect,
                                 const Rect* dstRect, short mode, RgnHandle maskRgn);
VELMAR_CLASSIC_API void CopyMask(const BitMap* srcBits, const BitMap* maskBits,
                                 const BitMap* dstBits, const Rect* srcRect, const Rect* maskRect,
                                 const Rect* dstRect);

VELMAR_CLASSIC_API RgnHandle NewRgn(void);
VELMAR_CLASSIC_API void DisposeRgn(RgnHandle rgn);
VELMAR_CLASSIC_API void CopyRgn(RgnHandle src, RgnHandle dst);
VELMAR_CLASSIC_API void SetEmptyRgn(RgnHandle rgn);
VELMAR_CLASSIC_API void SetRectRgn(RgnHandle rgn, short left, short top, short right, short bottom);
VELMAR_CLASSIC_API void RectRgn(RgnHandle rgn, const Rect* r);
VELMAR_CLASSIC_API void OpenRgn(void);
VELMAR_CLASSIC_API void CloseRgn(RgnHandle dst);
VELMAR_CLASSIC_API void OffsetRgn(RgnHandle rgn, short dh, short dv);
VELMAR_CLASSIC_API void InsetRgn(RgnHandle rgn, short dh, short dv);
VELMAR_CLASSIC_API void SectRgn(RgnHandle a, RgnHandle b, RgnHandle dst);
VELMAR_CLASSIC_API void UnionRgn(RgnHandle a, RgnHandle b, RgnHandle dst);
VELMAR_CLASSIC_API void DiffRgn(RgnHandle a, RgnHandle b, RgnHandle dst);
VELMAR_CLASSIC_API void XorRgn(RgnHandle a, RgnHandle b, RgnHandle dst);
VELMAR_CLASSIC_API Boolean PtInRgn(Point pt, RgnHandle rgn);
VELMAR_CLASSIC_API Boolean RectInRgn(const Rect* r, RgnHandle rgn);
VELMAR_CLASSIC_API Boolean EqualRgn(RgnHandle a, RgnHandle b);
VELMAR_CLASSIC_API Boolean EmptyRgn(RgnHandle rgn);
VELMAR_CLASSIC_API void FrameRgn(RgnHandle rgn);
VELMAR_CLASSIC_API void PaintRgn(RgnHandle rgn);
VELMAR_CLASSIC_API void EraseRgn(RgnHandle rgn);
VELMAR_CLASSIC_API void InvertRgn(RgnHandle rgn);
VELMAR_CLASSIC_API void FillRgn(RgnHandle rgn, const Pattern* pat);

VELMAR_CLASSIC_API void TextFont(short font);
VELMAR_CLASSIC_API void TextFace(StyleParameter face);
VELMAR_CLASSIC_API void TextMode(short mode);
VELMAR_CLASSIC_API void TextSize(short size);
VELMAR_CLASSIC_API void DrawChar(CharParameter ch);
VELMAR_CLASSIC_API void DrawString(ConstStr255Param s);
VELMAR_CLASSIC_API void DrawText(const void* textBuf, short firstByte, short byteCount);
VELMAR_CLASSIC_API short CharWidth(CharParameter ch);
VELMAR_CLASSIC_API short StringWidth(ConstStr255Param s);
VELMAR_CLASSIC_API short TextWidth(const void* textBuf, short firstByte, short byteCount);
VELMAR_CLASSIC_API void GetFontInfo(FontInfo* info);

VELMAR_CLASSIC_API void InitCursor(void);
VELMAR_CLASSIC_API void SetCursor(const Cursor* crsr);
VELMAR_CLASSIC_API void HideCursor(void);
VELMAR_CLASSIC_API void ShowCursor(void);
VELMAR_CLASSIC_API void ObscureCursor(void);
VELMAR_CLASSIC_API CursHandle GetCursor(short cursorID);

VELMAR_CLASSIC_API PatHandle GetPattern(short patternID);
VELMAR_CLASSIC_API void GetIndPattern(Pattern* thePat, short patternListID, short index);
VELMAR_CLASSIC_API PicHandle GetPicture(short pictureID);
VELMAR_CLASSIC_API void DrawPicture(PicHandle myPicture, const Rect* dstRect);
VELMAR_CLASSIC_API void KillPicture(PicHandle myPicture);
VELMAR_CLASSIC_API Handle GetIcon(short iconID);
VELMAR_CLASSIC_API void PlotIcon(const Rect* theRect, Handle theIcon);

/* Putting a port's drawing on the screen (the classic calls do it where programs look). */
VELMAR_CLASSIC_API void QDFlushPortBuffer(CGrafPtr port, RgnHandle region);

VELMAR_CLASSIC_END
#endif
