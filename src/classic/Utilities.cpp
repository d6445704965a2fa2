// Utilities: words and bits, the clock and dates, numbers as text, the machine's description,
// trap addresses, the beep and the delay.
#include "classic/ClassicPrivate.h"

#include <QDate>
#include <QDateTime>
#include <QLocale>
#include <QTime>

#include <cstring>

namespace {

// The classic epoch: midnight, 1 January 1904, local time.
const QDateTime& epoch()
{
    static const QDateTime e(QDate(1904, 1, 1), QTime(0, 0), Qt::UTC);
    return e;
}

QDateTime fromSeconds(unsigned long secs)
{
    return epoch().addSecs(qint64(secs & 0xFFFFFFFFUL));
}

void toPascal(const QString& text, Str255 out)
{
    VelmarClassic::copyToStr255(text.toLatin1(), out);
}

} // namespace

short HiWord(long x)
{
    return short((x >> 16) & 0xFFFF);
}
short LoWord(long x)
{
    return short(x & 0xFFFF);
}
long BitAnd(long a, long b)
{
    return long(int(a & b));
}
long BitOr(long a, long b)
{
    return long(int(a | b));
}
long BitXor(long a, long b)
{
    return long(int(a ^ b));
}
long BitNot(long a)
{
    return long(int(~a));
}

long BitShift(long value, short count)
{
    // A 32-bit value, shifted left for positive counts and logically right for negative ones.
    const auto v = Velmar::UInt32(value);
    const int n = count % 32;
    const Velmar::UInt32 r = n >= 0 ? (v << n) : (v >> -n);
    return long(Velmar::SInt32(r));
}

Boolean BitTst(const void* bytePtr, long bitNum)
{
    if (!VELMAR_ASSERT(bytePtr, "bytePtr != NULL"))
        return false;
    const auto* b = static_cast<const unsigned char*>(bytePtr);
    return (b[bitNum / 8] & (0x80 >> (bitNum % 8))) != 0;
}

void BitSet(void* bytePtr, long bitNum)
{
    if (VELMAR_ASSERT(bytePtr, "bytePtr != NULL"))
        static_cast<unsigned char*>(bytePtr)[bitNum / 8] |= (unsigned char)(0x80 >> (bitNum % 8));
}

void BitClr(void* bytePtr, long bitNum)
{
    if (VELMAR_ASSERT(bytePtr, "bytePtr != NULL"))
        static_cast<unsigned char*>(bytePtr)[bitNum / 8] &= (unsigned char)~(0x80 >> (bitNum % 8));
}

Fixed FixRatio(short numer, short denom)
{
    if (denom == 0)
        return numer >= 0 ? 0x7FFFFFFFL : -0x7FFFFFFFL;
    return Fixed((long long)numer * 65536 / denom);
}

Fixed FixMul(Fixed a, Fixed b)
{
    return Fixed(Velmar::SInt32(((long long)Velmar::SInt32(a) * Velmar::SInt32(b)) >> 16));
}

short FixRound(Fixed x)
{
    return short((Velmar::SInt32(x) + 0x8000) >> 16);
}

void GetDateTime(unsigned long* secs)
{
    if (!VELMAR_ASSERT(secs, "secs != NULL"))
        return;
    const QDateTime now = QDateTime::currentDateTime();
    const QDateTime local(now.date(), now.time(), Qt::UTC);
    *secs = (unsigned long)(epoch().secsTo(local) & 0xFFFFFFFFLL);
}

void Secs2Date(unsigned long secs, DateTimeRec* d)
{
    if (!VELMAR_ASSERT(d, "d != NULL"))
        return;
    const QDateTime t = fromSeconds(secs);
    d->year = short(t.date().year());
    d->month = short(t.date().month());
    d->day = short(t.date().day());
    d->hour = short(t.time().hour());
    d->minute = short(t.time().minute());
    d->second = short(t.time().second());
    d->dayOfWeek = short(t.date().dayOfWeek() % 7 + 1); // 1 is Sunday
}

void Date2Secs(const DateTimeRec* d, unsigned long* secs)
{
    if (!VELMAR_ASSERT(d && secs, "d && secs"))
        return;
    // Out-of-range fields carry over, as the classic call allowed.
    QDateTime t(QDate(d->year, 1, 1), QTime(0, 0), Qt::UTC);
    t = t.addMonths(d->month - 1).addDays(d->day - 1);
    t = t.addSecs(qint64(d->hour) * 3600 + qint64(d->minute) * 60 + d->second);
    *secs = (unsigned long)(epoch().secsTo(t) & 0xFFFFFFFFLL);
}

void GetTime(DateTimeRec* d)
{
    unsigned long now = 0;
    GetDateTime(&now);
    Secs2Date(now, d);
}

void IUDateString(unsigned long dateTime, short longFlag, Str255 result)
{
    if (!VELMAR_ASSERT(result, "result != NULL"))
        return;
    const QDate date = fromSeconds(dateTime).date();
    const QLocale c = QLocale::c();
    QString text;
    switch (longFlag) {
    case longDate: text = c.toString(date, QStringLiteral("dddd, MMMM d, yyyy")); break;
    case abbrevDate: text = c.toString(date, QStringLiteral("ddd, MMM d, yyyy")); break;
    default: text = c.toString(date, QStringLiteral("M/d/yy")); break;
    }
    toPascal(text, result);
}

void IUTimeString(unsigned long dateTime, Boolean wantSeconds, Str255 result)
{
    if (!VELMAR_ASSERT(result, "result != NULL"))
        return;
    const QTime time = fromSeconds(dateTime).time();
    toPascal(QLocale::c().toString(
                 time, wantSeconds ? QStringLiteral("h:mm:ss AP") : QStringLiteral("h:mm AP")),
        result);
}

void NumToString(long theNum, Str255 theString)
{
    if (VELMAR_ASSERT(theString, "theString != NULL"))
        toPascal(QString::number(Velmar::SInt32(theNum)), theString);
}

void StringToNum(ConstStr255Param theString, long* theNum)
{
    if (!VELMAR_ASSERT(theString && theNum, "theString && theNum"))
        return;
    Velmar::SInt32 n = 0;
    Velmar::StringToNum(theString, &n);
    *theNum = n; // the whole long, whatever it held before
}

Boolean EqualString(ConstStr255Param a, ConstStr255Param b, Boolean caseSens, Boolean diacSens)
{
    if (!VELMAR_ASSERT(a && b, "a && b"))
        return false;
    return Velmar::EqualString(a, b, caseSens, diacSens);
}

short RelString(ConstStr255Param a, ConstStr255Param b, Boolean caseSens, Boolean diacSens)
{
    if (!VELMAR_ASSERT(a && b, "a && b"))
        return 0;
    return Velmar::RelString(a, b, caseSens, diacSens);
}

void UpperString(Str255 theString, Boolean)
{
    if (!VELMAR_ASSERT(theString, "theString != NULL"))
        return;
    for (int i = 1; i <= theString[0]; ++i)
        if (theString[i] >= 'a' && theString[i] <= 'z')
            theString[i] = (unsigned char)(theString[i] - 'a' + 'A');
}

StringPtr c2pstr(char* s)
{
    if (!s)
        return nullptr;
    const size_t n = std::min<size_t>(std::strlen(s), 255);
    std::memmove(s + 1, s, n);
    s[0] = char(n);
    return reinterpret_cast<StringPtr>(s);
}

char* p2cstr(StringPtr s)
{
    if (!s)
        return nullptr;
    const size_t n = s[0];
    std::memmove(s, s + 1, n);
    s[n] = 0;
    return reinterpret_cast<char*>(s);
}

void CopyPascalStringToC(ConstStr255Param src, char* dst)
{
    if (!VELMAR_ASSERT(src && dst, "src && dst"))
        return;
    const size_t n = src[0];
    std::memmove(dst, src + 1, n);
    dst[n] = 0;
}

void CopyCStringToPascal(const char* src, Str255 dst)
{
    if (!VELMAR_ASSERT(src && dst, "src && dst"))
        return;
    const size_t n = std::min<size_t>(std::strlen(src), 255);
    std::memmove(dst + 1, src, n);
    dst[0] = (unsigned char)n;
}

OSErr SysEnvirons(short versionRequested, SysEnvRec* theWorld)
{
    if (!VELMAR_ASSERT(theWorld, "theWorld != NULL"))
        return paramErr;
    std::memset(theWorld, 0, sizeof *theWorld);
    theWorld->environsVersion = 2;
    theWorld->machineType = envMacII;
    theWorld->systemVersion = 0x0710;
    theWorld->processor = env68040;
    theWorld->hasFPU = true;
    theWorld->hasColorQD = true;
    theWorld->keyBoardType = envStandADBKbd;
    theWorld->sysVRefNum = -1;
    if (versionRequested <= 0)
        return envBadVers;
    return versionRequested > 2 ? OSErr(envVersTooBig) : OSErr(noErr);
}

OSErr Gestalt(OSType selector, long* response)
{
    if (!VELMAR_ASSERT(response, "response != NULL"))
        return paramErr;
    switch (selector) {
    case gestaltSystemVersion: *response = 0x0710; return noErr;
    case gestaltQuickdrawVersion: *response = gestalt32BitQD; return noErr;
    case gestaltQuickdrawFeatures: *response = 1L << gestaltHasColor; return noErr;
    case gestaltPhysicalRAMSize:
    case gestaltLogicalRAMSize: *response = 64L * 1024 * 1024; return noErr;
    case gestaltProcessorType: *response = gestaltCPU68040; return noErr;
    case gestaltFPUType: *response = gestaltNoFPU; return noErr;
    case gestaltTextEditVersion: *response = gestaltTE4; return noErr;
    case gestaltMachineType: *response = 0; return noErr;
    case gestaltAppleEventsAttr:
    case gestaltFSAttr:
    case gestaltDragMgrAttr:
    case gestaltOSAttr: *response = 0; return noErr;
    default: *response = 0; return gestaltUndefSelectorErr;
    }
}

void Delay(long numTicks, unsigned long* finalTicks)
{
    VelmarClassic::ensureStarted();
    VelmarClassic::flushAllPorts();
    Velmar::UInt32 final = 0;
    Velmar::Delay(numTicks > 0 ? Velmar::UInt32(numTicks) : 0, &final);
    if (finalTicks)
        *finalTicks = final;
}

void SysBeep(short duration)
{
    VelmarClassic::ensureStarted();
    Velmar::SysBeep(duration);
}

void Debugger()
{
    Velmar::Debugger();
}
void DebugStr(ConstStr255Param message)
{
    Velmar::DebugStr(message);
}

// ---- Trap addresses ------------------------------------------------------------------------
// Every trap a program asks about exists, except the one that stands for none.
namespace {
long trapAddress(unsigned short trapNum)
{
    return trapNum == _Unimplemented ? 0x40000000L : 0x40000000L + trapNum + 1;
}
} // namespace

UniversalProcPtr NGetTrapAddress(unsigned short trapNum, TrapType)
{
    return reinterpret_cast<UniversalProcPtr>(trapAddress(trapNum));
}
UniversalProcPtr GetToolTrapAddress(unsigned short trapNum)
{
    return NGetTrapAddress(trapNum, ToolTrap);
}
UniversalProcPtr GetOSTrapAddress(unsigned short trapNum)
{
    return NGetTrapAddress(trapNum, OSTrap);
}
UniversalProcPtr GetTrapAddress(unsigned short trapNum)
{
    return NGetTrapAddress(trapNum, ToolTrap);
}
