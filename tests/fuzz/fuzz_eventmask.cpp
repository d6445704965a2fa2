// The classic event-mask parser and what is built on it: posting any code, flushing and
// searching by any mask, against a model of which events each mask takes.
#include "FuzzSupport.h"

#include "events/EventMask.h"
#include "events/EventQueue.h"

#include <Velmar/EventWaiting.h>
#include <Velmar/Events.h>

using namespace Velmar;
using VelmarFuzz::Bytes;

namespace {

// Which classic codes a mask names, straight from the bit meanings. A mask of 0, like
// everyEvent, parses to no pairs, and no pairs match every event.
bool maskTakes(UInt16 mask, UInt16 code)
{
    return mask == everyEvent || mask == 0 || (code >= 1 && code <= 15 && (mask & (1u << code)));
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    VelmarFuzz::ensureApplication();
    Private::gMainEventQueue.clearAll();
    Bytes in(data, size);
    bool postedNull = false;
    while (!in.empty()) {
        const UInt16 mask = in.u16();
        Private::EventTypeList list;
        const int n = Private::ParseEventMask(mask, list);
        FUZZ_CHECK(n >= -1 && n <= Private::EventTypeList::kCapacity);
        FUZZ_CHECK(n < 0 || UInt32(n) == list.count);
        FUZZ_CHECK((mask == everyEvent) == (n == 0 && mask != 0));
        // Every pair the parser gives belongs to a bit of the mask.
        for (UInt32 i = 0; n > 0 && i < list.count; ++i) {
            EventTypeSpec type{};
            bool found = false;
            for (UInt16 code = 1; code <= 6; ++code) {
                if (Private::ClassicEventType(code, type)
                    && type.eventClass == list.specs[i].eventClass
                    && type.eventKind == list.specs[i].eventKind)
                    found = found || (mask & (1u << code));
            }
            const bool activateOrOs = list.specs[i].eventClass == kEventClassWindow
                || list.specs[i].eventClass == kEventClassApplication;
            FUZZ_CHECK(found || activateOrOs);
        }
        const UInt16 code = UInt16(in.u8() % 24);
        PostEvent(code, in.u32());
        postedNull = postedNull || code == nullEvent;
        switch (in.u8() % 4) {
        case 0: {
            // A flush by mask leaves only what the mask does not name (posted codes 1-6 have
            // classic kinds; the others travel privately and only everyEvent names them).
            const UInt32 before = Private::gMainEventQueue.count();
            FlushEvents(mask, 0);
            FUZZ_CHECK(Private::gMainEventQueue.count() <= before);
            break;
        }
        case 1: {
            EventRecord e{};
            e.what = 0xFFFF;
            const bool avail = EventAvail(mask, &e);
            FUZZ_CHECK(!avail || e.what == nullEvent || maskTakes(mask, e.what)
                || mask == everyEvent || e.what > 15);
            break;
        }
        case 2: {
            EventRecord e{};
            // A null event comes back only when the host posted one itself.
            if (GetNextEvent(mask, &e))
                FUZZ_CHECK(e.what != nullEvent || postedNull);
            break;
        }
        default: break;
        }
    }
    Private::gMainEventQueue.clearAll();
    return 0;
}
