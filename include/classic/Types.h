/* Basic types of the classic C interface: integers as classic programs declare them, points,
   rectangles, Pascal strings, handles. Compiles as C89, C99 and C++. */
#ifndef VELMAR_CLASSIC_TYPES_H
#define VELMAR_CLASSIC_TYPES_H

#if defined(__cplusplus)
#define VELMAR_CLASSIC_BEGIN extern "C" {
#define VELMAR_CLASSIC_END }
#else
#define VELMAR_CLASSIC_BEGIN
#define VELMAR_CLASSIC_END
#endif

#if defined(_WIN32) && !defined(VELMAR_CLASSIC_STATIC)
#if defined(velmar_classic_EXPORTS)
#define VELMAR_CLASSIC_API __declspec(dllexport)
#else
#define VELMAR_CLASSIC_API __declspec(dllimport)
#endif
#elif defined(__GNUC__)
#define VELMAR_CLASSIC_API __attribute__((visibility("default")))
#else
#define VELMAR_CLASSIC_API
#endif

/* Old compilers knew these as keywords; here they are empty. */
#ifndef pascal
#define pascal
#endif
#ifndef far
#define far
#endif
#ifndef nil
#define nil 0
#endif
#ifndef NULL
#if defined(__cplusplus)
#define NULL 0
#else
#define NULL ((void*)0)
#endif
#endif

#if !defined(__cplusplus) && !defined(true) && !defined(__bool_true_false_are_defined)
#define true 1
#define false 0
#endif
#ifndef TRUE
#define TRUE 1
#endif
#ifndef FALSE
#define FALSE 0
#endif

VELMAR_CLASSIC_BEGIN

typedef signed char SInt8;
typedef unsigned char UInt8;
typedef short SInt16;
typedef unsigned short UInt16;
/* A "long" of the classic headers: programs pass long* where these are asked for. */
typedef long SInt32;
typedef unsigned long UInt32;
typedef char SignedByte;
typedef unsigned char Byte;
typedef unsigned char Boolean;
typedef long Fixed;
typedef long Fract;
typedef short OSErr;
typedef long OSStatus;
typedef unsigned long OSType;
typedef unsigned long ResType;
typedef unsigned long FourCharCode;
typedef long Size;
typedef unsigned char Style;
typedef short StyleParameter;
typedef short CharParameter;
typedef unsigned char Str255[256];
typedef unsigned char Str63[64];
typedef unsigned char Str32[33];
typedef unsigned char Str31[32];
typedef unsigned char Str27[28];
typedef unsigned char Str15[16];
typedef unsigned char* StringPtr;
typedef StringPtr* StringHandle;
typedef const unsigned char* ConstStr255Param;
typedef const unsigned char* ConstStr63Param;
typedef const unsigned char* ConstStr31Param;
typedef char* Ptr;
typedef Ptr* Handle;
typedef long (*ProcPtr)();
typedef ProcPtr UniversalProcPtr;
typedef void* LogicalAddress;

#if !defined(VELMAR_CLASSIC_SHARES_RECT)
typedef struct Point {
    short v;
    short h;
} Point;
typedef struct Rect {
    short top;
    short left;
    short bottom;
    short right;
} Rect;
#else
typedef struct Point Point;
typedef struct Rect Rect;
#endif
typedef Point* PointPtr;
typedef Rect* RectPtr;

enum {
    noErr = 0,
    unimpErr = -4,
    paramErr = -50,
    memFullErr = -108,
    nilHandleErr = -109,
    memWZErr = -111,
    resNotFound = -192,
    resFNotFound = -193,
    addResFailed = -194,
    rmvResFailed = -196,
    resAttrErr = -198,
    mapReadErr = -199,
    ioErr = -36,
    dirNFErr = -120,
    fnfErr = -43,
    dupFNErr = -48,
    opWrErr = -49,
    permErr = -54,
    wrPermErr = -61,
    userCanceledErr = -128
};

#define FOUR_CHAR_CODE(x) (x)

VELMAR_CLASSIC_END

#endif
