// The Menu Manager's walks: MenuKey over 20 menus of 30 items with no match (every item is
// looked at), and AppendMenu of a 40-item string.
#include "BenchSupport.h"

#include <Velmar/Menus.h>

#include <QMenu>

using namespace Velmar;

namespace {

QByteArray pascal(const QByteArray& text)
{
    return char(text.size()) + text;
}

void Menus_MenuKeyNoMatch(benchmark::State& state)
{
    std::vector<MenuRef> menus;
    for (SInt16 id = 1; id <= 20; ++id) {
        MenuRef menu = NewMenu(id, reinterpret_cast<const unsigned char*>("\x04Menu"));
        for (int item = 1; item <= 30; ++item) {
            AppendMenu(menu, reinterpret_cast<const unsigned char*>("\x04Item"));
            SetItemCmd(menu, UInt16(item), SInt16('A' + item % 26)); // every item has a key
        }
        InsertMenu(menu, -1);
        menus.push_back(menu);
    }
    for (auto _ : state)
        benchmark::DoNotOptimize(MenuKey('!'));
    for (MenuRef menu : menus) {
        DeleteMenu(GetMenuID(menu));
        DisposeMenu(menu);
    }
}

void Menus_AppendMenu40(benchmark::State& state)
{
    QByteArrayList items;
    for (int i = 0; i < 40; ++i)
        items << "It" + QByteArray::number(i);
    const QByteArray data = pascal(items.join(';'));
    MenuRef menu = NewMenu(1, reinterpret_cast<const unsigned char*>("\x04Menu"));
    for (auto _ : state) {
        AppendMenu(menu, reinterpret_cast<const unsigned char*>(data.constData()));
        state.PauseTiming();
        menu->clear();
        state.ResumeTiming();
    }
    DisposeMenu(menu);
}

} // namespace

BENCHMARK(Menus_MenuKeyNoMatch)->Name("Menus/MenuKeyNoMatch20x30");
BENCHMARK(Menus_AppendMenu40)->Name("Menus/AppendMenu40");

VELMAR_BENCHMARK_MAIN()
