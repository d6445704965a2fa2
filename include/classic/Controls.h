/* Controls: only the record type that windows name. */
#ifndef VELMAR_CLASSIC_CONTROLS_H
#define VELMAR_CLASSIC_CONTROLS_H
#include "Quickdraw.h"
VELMAR_CLASSIC_BEGIN
typedef struct ControlRecord {
    struct ControlRecord** nextControl;
    GrafPtr contrlOwner;
    Rect contrlRect;
    unsigned char contrlVis;
    unsigned char contrlHilite;
    short contrlValue;
    short contrlMin;
    short contrlMax;
    Handle contrlDefProc;
    Handle contrlData;
    ProcPtr contrlAction;
    long contrlRfCon;
    Str255 contrlTitle;
} ControlRecord;
typedef ControlRecord* ControlPtr;
typedef ControlPtr* ControlHandle;
typedef ControlHandle ControlRef;
VELMAR_CLASSIC_END
#endif
