// The parameter table of an event and GetEventParameter / SetEventParameter.
#include "events/EventQueueItem.h"

#include <Velmar/Diagnostics.h>
#include <Velmar/MacErrors.h>

#include <cstddef>
#include <cstring>

namespace Velmar {

namespace {

using Private::EventQueueItem;

struct EventParameter {
    EventParamName name;
    EventParamType type;
    ByteCount size;
    std::size_t offset; // of the field in EventQueueItem
};

// Searched linearly in this order. The direct object's size and type are what callers
// size their buffers by, so they stay as they are.
const EventParameter kEventParameterList[] = {
    {kEventParamMouseButton, typeMouseButton, 2, offsetof(EventQueueItem, mouseButton)},
    {kEventParamWindowRef, typeWindowRef, sizeof(AQtWindow*), offsetof(EventQueueItem, window)},
    {kEventParamWindowPartCode, typeWindowPartCode, 2, offsetof(EventQueueItem, windowPart)},
    {kEventParamMouseLocation, typeQDPoint, 4, offsetof(EventQueueItem, where)},
    {kEventParamKeyModifiers, typeUInt32, 4, offsetof(EventQueueItem, modifiers)},
    {kEventParamKeyCode, typeUInt32, 4, offsetof(EventQueueItem, keyCode)},
    {kEventParamKeyMacCharCodes, typeChar, 1, offsetof(EventQueueItem, charCode)},
    {kEventParamMouseWheelAxis, typeMouseWheelAxis, 2, offsetof(EventQueueItem, wheelAxis)},
    {kEventParamMouseWheelDelta, typeLongInteger, 4, offsetof(EventQueueItem, wheelDelta)},
    {kEventParamCurrentBounds, typeQDRectangle, 8, offsetof(EventQueueItem, currentBounds)},
    {kEventParamDirectObject, typeFSVolumeRefNum, 6, offsetof(EventQueueItem, directObject)},
};

static_assert(sizeof(Point) == 4 && sizeof(Rect) == 8, "Toolbox value layouts");

const EventParameter* findParameter(EventParamName name)
{
    for (const EventParameter& p : kEventParameterList) {
        if (p.name == name)
            return &p;
    }
    return nullptr;
}

unsigned char* fieldOf(EventQueueItem* item, const EventParameter& p)
{
    return reinterpret_cast<unsigned char*>(item) + p.offset;
}

bool allZero(const unsigned char* bytes, ByteCount size)
{
    for (ByteCount i = 0; i < size; ++i) {
        if (bytes[i] != 0)
            return false;
    }
    return true;
}

} // namespace

OSStatus GetEventParameter(EventRef event, EventParamName name, EventParamType desiredType,
                           EventParamType* outActualType, ByteCount bufferSize,
                           ByteCount* outActualSize, void* outData)
{
    if (!event || !VELMAR_CHECK_EVENT(event))
        return paramErr;
    if (outData)
        std::memset(outData, 0, bufferSize);

    const EventParameter* p = findParameter(name);
    if (!p)
        return eventParameterNotFoundErr;
    if (outActualType)
        *outActualType = p->type;
    if (outActualSize)
        *outActualSize = p->size;
    if (p->type != desiredType)
        return errAECoercionFail;
    if (!outData)
        return noErr;
    if (p->size > bufferSize)
        return errAECoercionFail;

    const unsigned char* field = fieldOf(event, *p);
    const bool wheelPair = name == kEventParamMouseWheelAxis || name == kEventParamMouseWheelDelta;
    // A zero-valued parameter counts as absent, deliberately; only the wheel pair of a
    // wheel event may legitimately be zero.
    if (!(wheelPair && event->isMouseWheelEvent()) && allZero(field, p->size))
        return eventParameterNotFoundErr;
    std::memcpy(outData, field, p->size);
    return noErr;
}

OSStatus SetEventParameter(EventRef event, EventParamName name, EventParamType type, ByteCount size,
                           const void* data)
{
    if (!event || !VELMAR_CHECK_EVENT(event))
        return eventInternalErr;
    const EventParameter* p = findParameter(name);
    if (!VELMAR_ASSERT(p, "false"))
        return unimpErr;
    VELMAR_ASSERT(p->type == type, "kEventParameterList[idx].type == inType");
    VELMAR_ASSERT(p->size == size, "kEventParameterList[idx].size == inSize");
    if (!data) {
        VelmarLog(kLogEvents, "SetEventParameter: no data for parameter");
        return paramErr;
    }
    // The table's size is what is stored; a shorter source is not read past its end.
    unsigned char* field = fieldOf(event, *p);
    const ByteCount copied = size < p->size ? size : p->size;
    std::memcpy(field, data, copied);
    std::memset(field + copied, 0, p->size - copied);
    return noErr;
}

} // namespace Velmar
