// For the suite's Wayland run (VELMAR_TEST_PLATFORM=wayland): skips a test (or, in
// initTestCase, the whole file) that needs what the window system may not give, and says why.
#pragma once

#include <QClipboard>
#include <QGuiApplication>
#include <QtTest>

// What only an X server gives: windows at screen positions, a stacking order to read, XTest
// input. `need` says which.
#define VELMAR_REQUIRE_X11(need)                                                            \
    do {                                                                                    \
        if (QGuiApplication::platformName() != QLatin1String("xcb"))                        \
            QSKIP("needs X11 (" need "); a Wayland compositor does not allow it");          \
    } while (false)

// A clipboard: a Wayland compositor gives one only to a client on a seat (the headless
// weston of the test run has none). Probed by a round trip.
#define VELMAR_REQUIRE_CLIPBOARD()                                                          \
    do {                                                                                    \
        QClipboard* clipboard = QGuiApplication::clipboard();                               \
        clipboard->setText(QStringLiteral("velmar clipboard probe"));                       \
        if (clipboard->text() != QStringLiteral("velmar clipboard probe"))                  \
            QSKIP("needs a clipboard; a Wayland compositor gives one only on a seat");      \
    } while (false)
