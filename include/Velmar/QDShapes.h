// QuickDraw shapes, lines, polygons and rectangle and point utilities.
#pragma once

#include <Velmar/QDTypes.h>

#include <QList>
#include <QPoint>

class QRect;

namespace Velmar {

// A polygon: its points in local coordinates, in the order they were recorded.
// Made by OpenPoly, freed by KillPoly.
struct VELMAR_EXPORT PolyPtr {
    QPolygon* qPoly;
};

// Rectangles.
VELMAR_EXPORT void FrameRect(const Rect* r);
VELMAR_EXPORT void PaintRect(const Rect* r);
VELMAR_EXPORT void EraseRect(const Rect* r);
VELMAR_EXPORT void FillRect(const Rect* r, const PatPtr& pattern);
VELMAR_EXPORT void InvertRect(const Rect* r);
VELMAR_EXPORT void StdRect(SInt16 verb, const Rect* r);

// Ovals, arcs and rounded rectangles. Angles are Toolbox degrees: clockwise from 12 o'clock.
VELMAR_EXPORT void FrameOval(const Rect* r);
VELMAR_EXPORT void PaintOval(const Rect* r);
VELMAR_EXPORT void EraseOval(const Rect* r);
VELMAR_EXPORT void FillOval(const Rect* r, const PatPtr& pattern);
VELMAR_EXPORT void InvertOval(const Rect* r);
VELMAR_EXPORT void FrameArc(const Rect* r, short startAngle, short arcAngle);
VELMAR_EXPORT void PaintArc(const Rect* r, short startAngle, short arcAngle);
VELMAR_EXPORT void EraseArc(const Rect* r, short startAngle, short arcAngle);
VELMAR_EXPORT void FillArc(const Rect* r, short startAngle, short arcAngle, const PatPtr& pattern);
VELMAR_EXPORT void InvertArc(const Rect* r, short startAngle, short arcAngle);
VELMAR_EXPORT void FrameRoundRect(const Rect* r, short ovalWidth, short ovalHeight);
VELMAR_EXPORT void PaintRoundRect(const Rect* r, short ovalWidth, short ovalHeight);
VELMAR_EXPORT void EraseRoundRect(const Rect* r, short ovalWidth, short ovalHeight);
VELMAR_EXPORT void FillRoundRect(const Rect* r, short ovalWidth, short ovalHeight, const PatPtr& pattern);
VELMAR_EXPORT void InvertRoundRect(const Rect* r, short ovalWidth, short ovalHeight);

// Lines and the pen location.
VELMAR_EXPORT void MoveTo(short h, short v);
VELMAR_EXPORT void Move(short dh, short dv);
VELMAR_EXPORT void LineTo(short h, short v);
VELMAR_EXPORT void Line(short dh, short dv);
VELMAR_EXPORT void DrawLinesFromPointPairs(const QList<QPoint>& points);
VELMAR_EXPORT void DrawPolylineFromPoints(const QList<QPoint>& points);

// Polygons.
VELMAR_EXPORT PolyPtr* OpenPoly();
VELMAR_EXPORT void ClosePoly();
VELMAR_EXPORT void KillPoly(PolyPtr* poly);
VELMAR_EXPORT void OffsetPoly(PolyPtr* poly, short dh, short dv);
VELMAR_EXPORT void FramePoly(PolyPtr* poly);
VELMAR_EXPORT void PaintPoly(PolyPtr* poly);
VELMAR_EXPORT void FillPoly(PolyPtr* poly, const PatPtr& pattern);
VELMAR_EXPORT void ErasePoly(PolyPtr* poly);
VELMAR_EXPORT void InvertPoly(PolyPtr* poly);
VELMAR_EXPORT Rect GetPolyBBox(PolyPtr* const& poly);
VELMAR_EXPORT void GetPolyRect(PolyPtr* poly, QRect* out);

// Rectangle and point utilities; they need no port.
VELMAR_EXPORT void SetRect(Rect* r, short left, short top, short right, short bottom);
VELMAR_EXPORT void OffsetRect(Rect* r, short dh, short dv);
VELMAR_EXPORT void InsetRect(Rect* r, short dh, short dv);
VELMAR_EXPORT unsigned char SectRect(const Rect* a, const Rect* b, Rect* out);
VELMAR_EXPORT void UnionRect(const Rect* a, const Rect* b, Rect* out);
VELMAR_EXPORT unsigned char PtInRect(Point pt, const Rect* r);
VELMAR_EXPORT unsigned char EqualRect(const Rect* a, const Rect* b);
VELMAR_EXPORT unsigned char EmptyRect(const Rect* r);
VELMAR_EXPORT void Pt2Rect(Point a, Point b, Rect* out);
VELMAR_EXPORT void SetPt(Point* pt, short h, short v);
VELMAR_EXPORT unsigned char EqualPt(Point a, Point b);
VELMAR_EXPORT void AddPt(Point src, Point* dst);
VELMAR_EXPORT void SubPt(Point src, Point* dst);

} // namespace Velmar
