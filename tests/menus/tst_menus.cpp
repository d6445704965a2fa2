// The Menu Manager on QMenu and QAction: item strings, command keys, the menu list and its
// reference counts, choices, fonts, built-in menus, and hostile calls.
#include "TestSupport.h"

#include <Velmar/Diagnostics.h>
#include <Velmar/Menus.h>
#include <Velmar/QDText.h>

#include "events/EventQueue.h"
#include "menus/MenuPrivate.h"

#include "../resources/Fixtures.h"

#include <QMenuBar>
#include <QPointer>
#include <QResource>

using namespace Velmar;

namespace {

using Asserts = VelmarTest::IgnoredAssertions;

using VelmarTest::P;
using VelmarTest::pascal;

// A menu made by NewMenu and gone at the end of the scope, whatever the test did with it.
class Menu {
public:
    explicit Menu(SInt16 id, const char* items = nullptr)
        : m_menu(NewMenu(id, P(pascal("Menu " + QByteArray::number(id)))))
    {
        if (items)
            AppendMenu(m_menu, P(pascal(items)));
    }
    ~Menu()
    {
        if (GetMenuHandle(GetMenuID(m_menu)) == m_menu.get())
            DeleteMenu(GetMenuID(m_menu));
        if (Private::isLive(m_menu.get()))
            DisposeMenu(m_menu);
    }
    operator MenuRef() const { return m_menu; }
    QMenu* operator->() const { return m_menu.get(); }
    QMenu* get() const { return m_menu.get(); }

private:
    MenuRef m_menu;
};

QStringList texts(MenuRef menu)
{
    QStringList out;
    for (QAction* a : menu->actions())
        out << (a->isSeparator() ? QStringLiteral("-")
                                 : (a->isEnabled() ? QString() : QStringLiteral("(")) + a->text());
    return out;
}

QString shortcutOf(MenuRef menu, int item)
{
    return menu->actions().at(item - 1)->shortcut().toString();
}

// The anchor menu every host keeps at the end of the bar, so that InsertMenu(m, 0) has a
// place to go.
void ensureAnchor()
{
    if (!GetMenuHandle(kMenuBarAnchorID))
        InsertMenu(NewMenu(kMenuBarAnchorID, P(pascal("Window"))), kMenuBarAnchorID);
}

} // namespace

class TestMenus : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase()
    {
        SetLogCategory(kLogNotImpl, true);
        ensureAnchor();
    }

    void itemStrings()
    {
        Menu m(300, "Cut/X;Copy/C;(Paste/V;-;Select All/A");
        QCOMPARE(texts(m), (QStringList{"CutX", "CopyC", "(PasteV", "-", "Select AllA"}));
        for (int i : {0, 1, 2, 4})
            QVERIFY(m->actions().at(i)->property(kMenuItemManagedInside).toBool());
        QVERIFY(!m->actions().at(3)->property(kMenuItemManagedInside).toBool());

        InsertMenuItem(m, P(pascal("First;(Second")), 0);
        InsertMenuItem(m, P(pascal("Last")), 99);
        InsertMenuItem(m, P(pascal("Middle")), 2);
        QCOMPARE(texts(m),
            (QStringList{"First", "(Second", "Middle", "CutX", "CopyC", "(PasteV", "-",
                "Select AllA", "Last"}));
        const UInt16 before = CountMenuItems(m);
        AppendMenu(m, P(pascal("!</^;;")));
        AppendMenu(m, P(pascal(QByteArray(255, 'x'))));
        QCOMPARE(CountMenuItems(m), UInt16(before + 1));
        AppendMenuItemText(m, P(pascal("Plain/P;(not parsed")));
        QCOMPARE(texts(m).last(), QStringLiteral("Plain/P;(not parsed"));
        QVERIFY(!m->actions().last()->property(kMenuItemManagedInside).isValid());
    }

    void itemTexts()
    {
        Menu m(301, "One;Two;-");
        Str255 text;
        GetMenuItemText(m, 3, text);
        QCOMPARE(QByteArray(reinterpret_cast<char*>(text), 2), pascal("-"));
        GetMenuItemText(m, 9, text);
        QCOMPARE(text[0], (unsigned char)0);
        SetMenuItemText(m, 1, P(pascal(QByteArray("\0-dash", 6))));
        QCOMPARE(m->actions().at(0)->text(), QStringLiteral("-dash"));
        QVERIFY(!m->actions().at(0)->isSeparator());
        SetMenuItemText(m, 2, P(pascal("-")));
        QVERIFY(m->actions().at(1)->isSeparator());
        SetMenuItemText(m, 3, P(pascal("Back")));
        QVERIFY(!m->actions().at(2)->isSeparator());
        DeleteMenuItem(m, 2);
        DeleteMenuItem(m, 0);
        DeleteMenuItem(m, 7);
        QCOMPARE(texts(m), (QStringList{"-dash", "Back"}));
    }

    void commandKeys()
    {
        Menu m(302, "Save;Keep;Other");
        SetItemCmd(m, 1, 'S');
        QCOMPARE(shortcutOf(m, 1), QStringLiteral("Ctrl+S"));
        QCOMPARE(SetMenuItemModifiers(m, 1, kMenuShiftModifier), OSErr(noErr));
        QCOMPARE(shortcutOf(m, 1), QStringLiteral("Ctrl+Shift+S"));
        SetItemCmd(m, 2, 'K');
        SetMenuItemModifiers(m, 2, kMenuNoCommandModifier);
        QCOMPARE(shortcutOf(m, 2), QStringLiteral("K"));
        for (SInt16 ignored : {5, 32, 33}) {
            SetItemCmd(m, 2, ignored);
            SInt16 cmd = 0;
            GetItemCmd(m, 2, &cmd);
            QCOMPARE(cmd, SInt16('K'));
        }
        SetItemCmd(m, 2, 0);
        QCOMPARE(shortcutOf(m, 2), QString());
        UInt8 mods = 0;
        QCOMPARE(GetMenuItemModifiers(m, 1, &mods), OSErr(noErr));
        QCOMPARE(mods, UInt8(kMenuShiftModifier));

        Asserts asserts;
        QCOMPARE(GetMenuItemModifiers(m, 9, &mods), OSErr(menuItemNotFoundErr));
        QCOMPARE(SetMenuItemModifiers(nullptr, 1, 0), OSErr(menuInvalidErr));
        QCOMPARE(asserts.texts(), (QStringList{"action", "inMenu"}));

        // Command 27: the mark names the submenu, which must be in the menu list.
        Menu sub(200, "Deep");
        SetItemMark(m, 3, 200);
        SetItemCmd(m, 3, hMenuCmd);
        QVERIFY(!m->actions().at(2)->menu()); // 200 is not listed yet
        InsertMenu(sub, -1);
        SetItemCmd(m, 3, hMenuCmd);
        MenuRef found;
        QCOMPARE(GetMenuItemHierarchicalMenu(m, 3, &found), OSStatus(noErr));
        QCOMPARE(found.get(), sub.get());
        QCOMPARE(GetMenuItemHierarchicalMenu(m, 1, &found), OSStatus(menuNotFoundErr));
        QCOMPARE(GetMenuItemHierarchicalMenu(m, 8, &found), OSStatus(menuItemNotFoundErr));
        SetItemCmd(m, 3, 'O'); // an ordinary key takes the submenu away
        QVERIFY(!m->actions().at(2)->menu());
    }

    void marksStylesAndEnabling()
    {
        Menu m(303, "A;B;-;C");
        SetItemMark(m, 1, 0x12);
        SInt16 mark = 0;
        GetItemMark(m, 1, &mark);
        QCOMPARE(mark, SInt16(0x12));
        QVERIFY(m->actions().at(0)->isChecked());
        CheckMenuItem(m, 1, 0);
        QVERIFY(!m->actions().at(0)->isCheckable());

        SetItemStyle(m, 2, bold | italic);
        unsigned char style = underline; // ORed into, not cleared
        GetItemStyle(m, 2, &style);
        QCOMPARE(int(style), bold | italic | underline);
        {
            Asserts asserts;
            SetItemStyle(m, 2, outline | extend | bold);
            QCOMPARE(asserts.texts(),
                (QStringList{"0 == (chStyle & outline)", "0 == (chStyle & extend)"}));
        }

        DisableMenuItem(m, 2);
        QCOMPARE(IsMenuItemEnabled(m, 2), Boolean(0));
        QCOMPARE(IsMenuItemEnabled(m, 3), Boolean(0)); // separators never are
        DisableMenuItem(m, 0);
        QVERIFY(!m->menuAction()->isEnabled());
        EnableMenuItem(m, 0);
        try {
            IsMenuItemEnabled(m, 99);
            QFAIL("no exception");
        } catch (const std::out_of_range& e) {
            QCOMPARE(QString::fromLatin1(e.what()),
                QStringLiteral("Out of range in Velmar::IsMenuItemEnabled: item==99"));
        }

        // Only items made from item strings are touched; EnableAll enters submenus,
        // DisableAll leaves items with submenus alone.
        Menu sub(204, "Inner");
        InsertMenu(sub, -1);
        AppendMenuItemText(m, P(pascal("plain")));
        AppendMenu(m, P(pascal("Hier")));
        SetItemMark(m, 6, 204);
        SetItemCmd(m, 6, hMenuCmd);
        DisableMenuItem(m, 5);
        DisableMenuItem(sub, 1);
        DisableAllMenuItems(m);
        QVERIFY(!m->actions().at(0)->isEnabled());
        QVERIFY(m->actions().at(5)->isEnabled()); // has a submenu
        EnableAllMenuItems(m);
        QVERIFY(m->actions().at(0)->isEnabled() && m->actions().at(1)->isEnabled());
        QVERIFY(!m->actions().at(4)->isEnabled()); // plain item: not managed
        QVERIFY(sub->actions().at(0)->isEnabled());
        QCOMPARE(MenuHasEnabledItems(m), Boolean(1));
        QCOMPARE(MenuHasEnabledItems(nullptr), Boolean(0));
        // A menu that is its own submenu ends the walk.
        SetItemMark(sub, 1, 204);
        SetItemCmd(sub, 1, hMenuCmd);
        EnableAllMenuItems(sub);
    }

    void listAndCounts()
    {
        QMenuBar* bar = AQtApplication::instance()->menuBar();
        MenuRef m = NewMenu(310, P(pascal("Counted")));
        QCOMPARE(Private::RefCount(m), 1);
        InsertMenu(m, 0); // before the anchor
        QCOMPARE(Private::RefCount(m), 2);
        QVERIFY(IsInMenuList(m));
        const QList<QAction*> actions = bar->actions();
        QCOMPARE(actions.indexOf(m->menuAction()) + 1,
            actions.indexOf(GetMenuHandle(kMenuBarAnchorID)->menuAction()));
        QPointer<QMenu> alive(m.get());
        DisposeMenu(m); // disposed while in the bar: only counted down
        QVERIFY(alive && GetMenuHandle(310) == m.get());
        DeleteMenu(310);
        QVERIFY(!alive);
        QVERIFY(!GetMenuHandle(310));
        QVERIFY(!bar->actions().contains(nullptr));
        DeleteMenu(310); // unknown: nothing

        MenuRef hidden = NewMenu(311, P(pascal("Hidden")));
        InsertMenu(hidden, -1);
        QVERIFY(!bar->actions().contains(hidden->menuAction()));
        QCOMPARE(GetMenuHandle(311).get(), hidden.get());
        DeleteMenu(311);
        DisposeMenu(hidden);

        // Without the anchor, InsertMenu(m, 0) asserts and appends.
        MenuRef anchor = GetMenuHandle(kMenuBarAnchorID);
        DeleteMenu(kMenuBarAnchorID);
        {
            Asserts asserts;
            MenuRef lone = NewMenu(312, P(pascal("Lone")));
            InsertMenu(lone, 0);
            QCOMPARE(asserts.texts(),
                QStringList{
                    "false && \"Velmar::Private::InsertMenuToMenuBar: Should not be here\""});
            QCOMPARE(bar->actions().last(), lone->menuAction());
            DeleteMenu(312);
            DisposeMenu(lone);
        }
        DisposeMenu(anchor);
        ensureAnchor();

        Str255 title;
        QCOMPARE(GetMenuTitle(nullptr, title), nullptr);
        MenuRef copy;
        QCOMPARE(DuplicateMenu(nullptr, &copy), OSStatus(menuInvalidErr));
        Menu source(313, "Shared");
        QCOMPARE(DuplicateMenu(source, &copy), OSStatus(noErr));
        QCOMPARE(copy->actions(), source->actions());
        QCOMPARE(GetMenuTitle(copy, title), title);
        QCOMPARE(QByteArray(reinterpret_cast<char*>(title), title[0] + 1), pascal("Menu 313"));
        DisposeMenu(copy);
        QCOMPARE(GetMenuID(nullptr), SInt16(-1));
    }

    // A built-in menu is a fresh copy each time; an ID with no menu asserts once and gives
    // the placeholder (the built-in items themselves are a table, not a rule to test).
    void builtInMenus()
    {
        MenuRef a = GetMenu(136), b = GetMenu(136);
        QVERIFY(a.get() != b.get());
        QCOMPARE(texts(a), (QStringList{"Even", "Odd"}));
        Asserts asserts;
        MenuRef unknown = GetMenu(9999);
        QCOMPARE(asserts.texts(), QStringList{"Creating menu with unknown ID: 9999"});
        QCOMPARE(unknown->title(),
            QStringLiteral("Some kind of unknown menu. Contact Orrin ASAP!!!!! MenuID#9999"));
        QCOMPARE(texts(unknown),
            QStringList{"(We don't yet support loading menus from resources. MenuID: 9999"});
        QVERIFY(!IsInMenuList(unknown));
        for (MenuRef m : {a, b, unknown})
            DisposeMenu(m);
    }

    void choices()
    {
        Menu low(320, "Open;Save");
        Menu high(321, "Save As;Close");
        InsertMenu(low, 0);
        InsertMenu(high, 0);
        SetItemCmd(low, 2, 'S');
        SetItemCmd(high, 1, 'S');
        SetItemCmd(high, 2, 'W');
        SetMenuItemModifiers(high, 2, kMenuShiftModifier);
        QCOMPARE(MenuKey('s'), SInt32((320 << 16) | 2));
        DisableMenuItem(low, 2); // a disabled match is passed over
        QCOMPARE(MenuKey('S'), SInt32((321 << 16) | 1));
        EnableMenuItem(low, 2);
        DisableMenuItem(low, 0); // a disabled menu is skipped
        QCOMPARE(MenuKey('S'), SInt32((321 << 16) | 1));
        EnableMenuItem(low, 0);
        QCOMPARE(MenuKey('q'), SInt32(0));

        EventRecord e{};
        e.what = keyDown;
        e.message = 'w';
        e.modifiers = cmdKey | rightShiftKey | controlKey;
        QCOMPARE(MenuEvent(&e), UInt32((321 << 16) | 2));
        e.what = keyUp;
        QCOMPARE(MenuEvent(&e), UInt32(0));
        QCOMPARE(MenuEvent(nullptr), UInt32(0));

        // A fired item is the pending choice once, and the menu-chosen event is queued.
        Private::gMainEventQueue.clearAll();
        low->actions().at(1)->trigger();
        QCOMPARE(MenuSelect(Point{}), SInt32((320 << 16) | 2));
        QCOMPARE(MenuSelect(Point{}), SInt32(0));
        QCOMPARE(Private::gMainEventQueue.items().size(), 1);
        // Plain items report through their menu.
        AppendMenuItemText(high, P(pascal("Plain")));
        high->actions().at(2)->trigger();
        QCOMPARE(MenuSelect(Point{}), SInt32((321 << 16) | 3));

        // A custom-drawn menu reports its selected item.
        high->setProperty("MDEF", true);
        high->setProperty("selecteditem", 7);
        QCOMPARE(Private::CalculateMenuSelectInfo(high->actions().at(0)), SInt32((321 << 16) | 7));
        high->setProperty("selecteditem", 0);
        QCOMPARE(Private::CalculateMenuSelectInfo(high->actions().at(0)), SInt32(0));
    }

    void fonts()
    {
        Menu m(330, "Item");
        {
            Asserts asserts;
            QCOMPARE(SetMenuFont(nullptr, geneva, 12), OSStatus(menuInvalidErr));
            QCOMPARE(asserts.texts(), QStringList{"menu"});
        }
        SetGlobalMenuFontFamily(monaco);
        SetGlobalMenuFontSize(16);
        Private::ApplyMenuFont(m.get());
        QCOMPARE(m->font().family(), QStringLiteral("Courier New"));
        QCOMPARE(m->font().pointSizeF(), 12.0);
        QCOMPARE(SetMenuFont(m, geneva, 12), OSStatus(noErr));
        Private::ApplyMenuFont(m.get());
        QCOMPARE(m->font().family(), QStringLiteral("Arial"));
        QCOMPARE(m->font().pointSizeF(), 9.0);
        SetGlobalMenuFontFamily(0);
        SetGlobalMenuFontSize(0);
        QCOMPARE(GetGlobalMenuFontSize(), SInt16(0));

        AppendResMenu(m, FOUR_CHAR_CODE("FONT"));
        QVERIFY(CountMenuItems(m) > 5);
        QVERIFY(texts(m).contains(QStringLiteral("Times New Roman")));
        VelmarTest::LogCapture log;
        AppendResMenu(m, FOUR_CHAR_CODE("snd "));
        QVERIFY(log.contains("[E_NOTIMPL] Velmar::AppendResMenu is not implemented yet!"));
        QCOMPARE(texts(m).last(),
            QStringLiteral("(We don't yet support loading menus from resources in "
                           "AppendResMenu for ResType: snd "));
    }

    void popUpArguments()
    {
        Menu empty(340);
        QCOMPARE(PopUpMenuSelect(empty, 10, 10, 0), SInt32(0));
        Menu three(341, "a;b;c");
        try {
            PopUpMenuSelect(three, 10, 10, 4);
            QFAIL("no exception");
        } catch (const std::out_of_range& e) {
            QCOMPARE(QString::fromLatin1(e.what()),
                QStringLiteral("Out of range in Velmar::PopUpMenuSelect: popUpItem==4"));
        }
        // Long plain menus become lists; a separator keeps them menus.
        QStringList many;
        for (int i = 0; i < 200; ++i)
            many << QStringLiteral("Entry %1").arg(i);
        Menu longMenu(342);
        AppendMenu(longMenu, P(pascal(many.mid(0, 40).join(';').toLatin1())));
        for (int i = 1; i < 5; ++i)
            AppendMenu(longMenu, P(pascal(many.mid(i * 40, 40).join(';').toLatin1())));
        QVERIFY(!Private::NeedsListPopup(QPoint(5, 5), three.get()));
        QVERIFY(Private::NeedsListPopup(QPoint(5, 5), longMenu.get()));
        AppendMenu(longMenu, P(pascal("-")));
        QVERIFY(!Private::NeedsListPopup(QPoint(5, 5), longMenu.get()));
    }

    // Icon n is resource n + 256: a colour icon, else a black-and-white one; a small icon for
    // items whose command is 30. The fixture family 200 has every kind, 201 only 'SICN' of
    // these, 202 nothing.
    void itemIcons()
    {
        if (!QResource::registerResource(QStringLiteral(VELMAR_RESOURCE_FIXTURES)))
            QSKIP("the resource fixtures are not built");
        Menu m(360, "Colour;Small");
        auto centre = [&](int item) {
            return m->actions().at(item - 1)->icon().pixmap(32, 32).toImage().pixel(10, 10);
        };
        SetItemIcon(m, 1, 200 - 256);
        QCOMPARE(centre(1), Fixtures::familyColour("cicn"));
        SInt16 icon = 0;
        GetItemIcon(m, 1, &icon);
        QCOMPARE(icon, SInt16(200 - 256));
        SetItemIcon(m, 1, 202 - 256); // nothing found: the icon stays
        QCOMPARE(centre(1), Fixtures::familyColour("cicn"));
        SetItemIcon(m, 1, 0);
        QVERIFY(m->actions().at(0)->icon().isNull());
        SetItemCmd(m, 2, kMenuSmallIconCmd);
        SetItemIcon(m, 2, 201 - 256);
        QCOMPARE(centre(2), Fixtures::familyColour("SICN"));
        QResource::unregisterResource(QStringLiteral(VELMAR_RESOURCE_FIXTURES));
    }

    // Every call given a menu that is gone asserts once and answers its neutral result.
    void deadMenusAreRefused()
    {
        MenuRef dead = NewMenu(350, P(pascal("Dead")));
        AppendMenu(dead, P(pascal("x")));
        DisposeMenu(dead);
        Str255 text;
        SInt16 value = 5;
        UInt8 mods = 0;
        unsigned char style = 0;
        MenuRef copy;
        const std::pair<const char*, std::function<void()>> calls[] = {
            {"DisposeMenu", [&] { DisposeMenu(dead); }},
            {"InsertMenu", [&] { InsertMenu(dead, 0); }},
            {"GetMenuID", [&] { QCOMPARE(GetMenuID(dead), SInt16(-1)); }},
            {"GetMenuTitle", [&] { QCOMPARE(GetMenuTitle(dead, text), nullptr); }},
            {"CountMenuItems", [&] { QCOMPARE(CountMenuItems(dead), UInt16(0)); }},
            {"DuplicateMenu",
                [&] { QCOMPARE(DuplicateMenu(dead, &copy), OSStatus(menuInvalidErr)); }},
            {"AppendMenu", [&] { AppendMenu(dead, P(pascal("y"))); }},
            {"GetMenuItemText", [&] { GetMenuItemText(dead, 1, text); }},
            {"SetItemCmd", [&] { SetItemCmd(dead, 1, 'x'); }},
            {"GetItemMark", [&] { GetItemMark(dead, 1, &value); }},
            {"GetItemStyle", [&] { GetItemStyle(dead, 1, &style); }},
            {"EnableMenuItem", [&] { EnableMenuItem(dead, 0); }},
            {"EnableAllMenuItems", [&] { EnableAllMenuItems(dead); }},
            {"GetMenuItemModifiers",
                [&] { QCOMPARE(GetMenuItemModifiers(dead, 1, &mods), OSErr(menuInvalidErr)); }},
            {"SetMenuFont", [&] { QCOMPARE(SetMenuFont(dead, 0, 0), OSStatus(menuInvalidErr)); }},
            {"PopUpMenuSelect", [&] { QCOMPARE(PopUpMenuSelect(dead, 0, 0, 1), SInt32(0)); }},
            {"AppendResMenu", [&] { AppendResMenu(dead, FOUR_CHAR_CODE("FONT")); }},
        };
        for (const auto& [name, call] : calls) {
            Asserts asserts;
            call();
            QVERIFY2(asserts.texts() == QStringList{QStringLiteral("IsValidMenu(menu)")}, name);
        }
        QCOMPARE(text[0], (unsigned char)0);
        // A menu made elsewhere is accepted once adopted.
        auto* own = new QMenu;
        MenuRef adopted = AdoptMenu(own);
        AppendMenu(adopted, P(pascal("z")));
        QCOMPARE(CountMenuItems(adopted), UInt16(1));
        DisposeMenu(adopted);
    }
};

VELMAR_APP_TEST_MAIN(TestMenus)
#include "tst_menus.moc"
