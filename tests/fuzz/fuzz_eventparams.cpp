// Event objects and their parameter table: any name, type, size and buffer, and any order of
// retains and releases, against the reference counts the host holds.
#include "FuzzSupport.h"

#include "events/EventQueueItem.h"

#include <Velmar/CarbonEvents.h>
#include <Velmar/MacErrors.h>

#include <vector>

using namespace Velmar;
using VelmarFuzz::Bytes;

namespace {

constexpr EventParamName kNames[] = {
    kEventParamMouseButton,
    kEventParamWindowRef,
    kEventParamWindowPartCode,
    kEventParamMouseLocation,
    kEventParamKeyModifiers,
    kEventParamKeyCode,
    kEventParamKeyMacCharCodes,
    kEventParamMouseWheelAxis,
    kEventParamMouseWheelDelta,
    kEventParamCurrentBounds,
    kEventParamDirectObject,
    FOUR_CHAR_CODE("junk"),
};

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    VelmarFuzz::ensureApplication();
    Bytes in(data, size);
    EventRef event = nullptr;
    FUZZ_CHECK(MacCreateEvent(nullptr, in.u32(), in.u32(), 0, in.u32(), &event) == noErr);
    int held = 1; // the host's own references
    while (!in.empty() && held > 0) {
        const uint8_t op = in.u8();
        const EventParamName name = kNames[in.u8() % std::size(kNames)];
        const EventParamType type = (op & 0x10) ? in.u32() : FOUR_CHAR_CODE("magn");
        uint8_t buffer[64];
        const ByteCount bufferSize = in.u8() % sizeof(buffer);
        switch (op % 5) {
        case 0: {
            uint8_t value[16] = {};
            in.take(value, sizeof(value));
            // The caller's bytes are what it claims; the table's size is what is stored.
            SetEventParameter(event, name, type, in.u8() % sizeof(value), value);
            break;
        }
        case 1: {
            EventParamType actualType = 0;
            ByteCount actualSize = 0;
            std::memset(buffer, 0xCC, sizeof(buffer));
            const OSStatus result =
                GetEventParameter(event, name, type, &actualType, bufferSize, &actualSize, buffer);
            FUZZ_CHECK(result == noErr || result == eventParameterNotFoundErr
                || result == errAECoercionFail);
            if (result == noErr)
                FUZZ_CHECK(actualSize <= bufferSize);
            // Nothing beyond the buffer the caller named is touched.
            for (ByteCount i = bufferSize; i < sizeof(buffer); ++i)
                FUZZ_CHECK(buffer[i] == 0xCC);
            break;
        }
        case 2:
            RetainEvent(event);
            ++held;
            break;
        case 3:
            ReleaseEvent(event);
            --held;
            break;
        default: {
            EventRecord record;
            ConvertEventRefToEventRecord(event, &record);
            GetEventTime(event);
            break;
        }
        }
    }
    // Releasing once more than held is refused, never a double free.
    for (int i = 0; i <= held; ++i)
        ReleaseEvent(event);
    return 0;
}
