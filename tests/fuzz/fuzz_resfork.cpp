// Resource forks and their wrappers from arbitrary bytes: either a fork comes out whose
// resources all lie inside the input and which survives writing and reading back, or the
// input is refused with a reason. Every decoder then runs over every resource.
#include "FuzzSupport.h"

#include "classic/resfile/Decoders.h"
#include "classic/resfile/ResourceFork.h"

#include <algorithm>
#include <tuple>

using namespace Velmar;
using namespace Velmar::Classic;

namespace {

auto key(const ResourceEntry& e)
{
    return std::make_tuple(e.type, e.id, e.attributes, e.name, e.data);
}

void decodeAll(const QByteArray& d)
{
    (void)decodeString(d), (void)decodeStringList(d), (void)decodeWindow(d), (void)decodeMenu(d);
    (void)decodeMenuBar(d), (void)decodeCursor(d), (void)decodePattern(d), (void)decodePatternList(d);
    (void)decodeIcon(d), (void)decodeIconList(d), (void)decodeSmallIcons(d), (void)decodeStyles(d);
    (void)decodeDialog(d), (void)decodeAlert(d), (void)decodeDialogItems(d), (void)decodeControl(d);
    (void)oneBitImage(d, 16, 16, d.mid(32));
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    const QByteArray bytes(reinterpret_cast<const char*>(data), qsizetype(size));
    QString why;
    const auto fork = ResourceFork::unwrap(bytes, &why);
    FUZZ_CHECK(fork || !why.isEmpty());
    if (!fork)
        return 0;
    qint64 total = 0;
    for (const ResourceEntry& e : fork->entries()) {
        total += e.data.size() + e.name.size();
        FUZZ_CHECK(e.name.size() <= 255);
        FUZZ_CHECK(fork->find(e.type, e.id) != nullptr);
        decodeAll(e.data);
    }
    FUZZ_CHECK(total <= qint64(size));

    const QByteArray written = fork->serialize();
    // Only forks of more than 64 KB can outgrow the map's 16-bit offsets.
    FUZZ_CHECK(!written.isEmpty() || size > 65535);
    if (written.isEmpty())
        return 0;
    const auto back = ResourceFork::parse(written, &why);
    FUZZ_CHECK(back);
    auto a = fork->entries(), b = back->entries();
    std::sort(a.begin(), a.end(), [](const auto& x, const auto& y) { return key(x) < key(y); });
    std::sort(b.begin(), b.end(), [](const auto& x, const auto& y) { return key(x) < key(y); });
    FUZZ_CHECK(a.size() == b.size());
    for (qsizetype i = 0; i < a.size(); ++i)
        FUZZ_CHECK(key(a[i]) == key(b[i]));
    return 0;
}
