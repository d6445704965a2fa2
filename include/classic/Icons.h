/* Icon plotting: black-and-white icons ('ICON', 'ICN#' with its mask, 'SICN') scaled into a
   rectangle of the current port. */
#ifndef VELMAR_CLASSIC_ICONS_H
#define VELMAR_CLASSIC_ICONS_H
#include "Quickdraw.h"
VELMAR_CLASSIC_BEGIN

typedef short IconAlignmentType;
typedef short IconTransformType;

enum {
    kAlignNone = 0x00, kAlignVerticalCenter = 0x01, kAlignTop = 0x02, kAlignBottom = 0x03,
    kAlignHorizontalCenter = 0x04, kAlignAbsoluteCenter = 0x05, kAlignCenterTop = 0x06,
    kAlignCenterBottom = 0x07, kAlignLeft = 0x08, kAlignCenterLeft = 0x09, kAlignTopLeft = 0x0A,
    kAlignBottomLeft = 0x0B, kAlignRight = 0x0C, kAlignCenterRight = 0x0D,
    kAlignTopRight = 0x0E, kAlignBottomRight = 0x0F
};
enum {
    atNone = 0x00, atVerticalCenter = 0x01, atTop = 0x02, atBottom = 0x03,
    atHorizontalCenter = 0x04, atAbsoluteCenter = 0x05, atCenterTop = 0x06,
    atCenterBottom = 0x07, atLeft = 0x08, atCenterLeft = 0x09, atTopLeft = 0x0A,
    atBottomLeft = 0x0B, atRight = 0x0C, atCenterRight = 0x0D, atTopRight = 0x0E,
    atBottomRight = 0x0F
};
enum {
    kTransformNone = 0x00, kTransformDisabled = 0x01, kTransformOffline = 0x02,
    kTransformOpen = 0x03, kTransformSelected = 0x4000,
    ttNone = 0x00, ttDisabled = 0x01, ttOffline = 0x02, ttOpen = 0x03, ttSelected = 0x4000
};

/* The 'ICN#' resource `theResID` (else its 'ICON'); resNotFound when there is neither. */
VELMAR_CLASSIC_API OSErr PlotIconID(const Rect* theRect, IconAlignmentType align,
                                    IconTransformType transform, short theResID);
/* A handle holding an 'ICN#' (icon and mask) or an 'ICON'. */
VELMAR_CLASSIC_API OSErr PlotIconHandle(const Rect* theRect, IconAlignmentType align,
                                        IconTransformType transform, Handle theIcon);
/* The first 16 x 16 icon of a 'SICN' handle; a second one, when there is, is its mask. */
VELMAR_CLASSIC_API OSErr PlotSICNHandle(const Rect* theRect, IconAlignmentType align,
                                        IconTransformType transform, Handle theSICN);

VELMAR_CLASSIC_END
#endif
