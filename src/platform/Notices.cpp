#include "platform/Notices.h"

namespace Velmar::Private::Platform {

namespace {

NoticeSink gSink = nullptr;
// A handful of kinds at most: a short list beats a set.
constexpr int kMaxKinds = 16;
const char* gGiven[kMaxKinds] = {};
int gGivenCount = 0;

bool alreadyGiven(const char* text)
{
    for (int i = 0; i < gGivenCount; ++i) {
        if (gGiven[i] == text)
            return true;
    }
    return false;
}

} // namespace

NoticeSink setNoticeSink(NoticeSink sink)
{
    NoticeSink previous = gSink;
    gSink = sink;
    return previous;
}

bool noticeOnce(const char* text)
{
    if (!text)
        return false;
    if (alreadyGiven(text))
        return true;
    if (!gSink || !gSink(text))
        return false;
    if (gGivenCount < kMaxKinds)
        gGiven[gGivenCount++] = text;
    return true;
}

void resetNotices()
{
    gGivenCount = 0;
}

} // namespace Velmar::Private::Platform
