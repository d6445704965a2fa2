// Feature flags and their preferences dialog: the store's version rule, caching and
// write-through, and what the dialog's boxes and buttons do to the flags.
#include "TestSupport.h"

#include <Velmar/FeatureFlags.h>

#include "foundation/FeatureFlagsPrivate.h"
#include "foundation/PrefDialog.h"

#include <QCheckBox>
#include <QGroupBox>
#include <QPushButton>
#include <QSettings>
#include <QSpinBox>

using namespace Velmar;
using namespace Velmar::Private;

namespace {

QSettings store()
{
    return QSettings(QLatin1String(kSettingsOrganization), QLatin1String(kSettingsApplication));
}

QPushButton* button(QtUIPrefDialog& dialog, const QString& text)
{
    for (QPushButton* b : dialog.findChildren<QPushButton*>()) {
        if (b->text() == text)
            return b;
    }
    return nullptr;
}

} // namespace

class TestFeatureFlags : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init()
    {
        store().clear();
        resetFeatureFlagCache();
    }

    // The first read fills a clean store with every default and the version.
    void cleanStoreGetsDefaults()
    {
        for (const FeatureFlagInfo& info : kFeatureFlags) {
            QCOMPARE(featureFlag(info.flag, kFeatureFlagQuery), info.defaultValue);
            QCOMPARE(store().value(QLatin1String(info.name), -1).toUInt(), info.defaultValue);
        }
        QCOMPARE(store().value(QLatin1String(kPreferencesVersionKey)).toInt(), 19);
    }

    // Stored values win and are read once per process.
    void storedValuesWinAndAreCached()
    {
        {
            QSettings s = store();
            s.setValue(QLatin1String(kPreferencesVersionKey), 19);
            s.setValue(QStringLiteral("MaximumStatUpdateRate"), 30);
            s.setValue(QStringLiteral("UseNativeEventAvail"), 0);
        }
        QCOMPARE(MaximumStatUpdateRate(kFeatureFlagQuery), 30u);
        QCOMPARE(UseNativeEventAvail(kFeatureFlagQuery), 0u);
        store().setValue(QStringLiteral("MaximumStatUpdateRate"), 45);
        QCOMPARE(MaximumStatUpdateRate(kFeatureFlagQuery), 30u);
    }

    // A store written by another version (or by none) is wiped and refilled with defaults.
    void otherVersionWipesStore()
    {
        for (const QVariant& version : {QVariant(18), QVariant(), QVariant(QStringLiteral("nineteen"))}) {
            init();
            {
                QSettings s = store();
                if (version.isValid())
                    s.setValue(QLatin1String(kPreferencesVersionKey), version);
                s.setValue(QStringLiteral("UseNativeEventAvail"), 0);
                s.setValue(QStringLiteral("SomeOldKey"), 5);
            }
            QCOMPARE(EnableLooperFiltering(kFeatureFlagQuery), 1u);
            QSettings s = store();
            QVERIFY(!s.contains(QStringLiteral("SomeOldKey")));
            QCOMPARE(s.value(QLatin1String(kPreferencesVersionKey)).toInt(), 19);
            QCOMPARE(UseNativeEventAvail(kFeatureFlagQuery), 1u);
        }
    }

    // Setting writes through only on a change; the version is checked once per process.
    void setWritesThroughOnlyOnChange()
    {
        QCOMPARE(SupportLegacyMacEventProcessing(0), 0u);
        QCOMPARE(store().value(QStringLiteral("SupportLegacyMacEventProcessing")).toUInt(), 0u);
        QCOMPARE(CCFastScrubCurrentMonitor(kFeatureFlagQuery), 1u); // no second wipe
        store().setValue(QStringLiteral("SupportLegacyMacEventProcessing"), 7);
        QCOMPARE(SupportLegacyMacEventProcessing(0), 0u);
        QCOMPARE(store().value(QStringLiteral("SupportLegacyMacEventProcessing")).toUInt(), 7u);
        QCOMPARE(SupportLegacyMacEventProcessing(2), 2u);
        resetFeatureFlagCache();
        QCOMPARE(SupportLegacyMacEventProcessing(kFeatureFlagQuery), 2u);
    }

    void dialogTextsAndBoxes()
    {
        QtUIPrefDialog dialog;
        QStringList groups;
        for (QGroupBox* g : dialog.findChildren<QGroupBox*>())
            groups << g->title();
        QCOMPARE(groups, (QStringList{QStringLiteral("Draw less or less often"),
                                      QStringLiteral("Delays from \"idle\" processes"),
                                      QStringLiteral("Low-level event system"),
                                      QStringLiteral("Web settings"),
                                      QStringLiteral("Artist Color Improvements")}));
        // The diagnostics counter has no box; a behaviour switch's box is named after its flag.
        QVERIFY(!dialog.checkBox(FeatureFlag::ReportPaintEventFrequency));
        QCOMPARE(dialog.checkBox(FeatureFlag::DeferrredDeleteInProcessNonCarbonEvents)->objectName(),
                 QStringLiteral("DeferrredDeleteInProcessNonCarbonEvents"));
    }

    void dialogShowsStoredValuesAndWritesThrough()
    {
        EnableDirectQtDrawing(1);
        MaximumStatUpdateRate(12);
        QtUIPrefDialog dialog;
        QVERIFY(dialog.checkBox(FeatureFlag::EnableDirectQtDrawing)->isChecked());
        QVERIFY(!dialog.checkBox(FeatureFlag::LimitPaintingCaptureToolOnIdle)->isChecked());
        QCOMPARE(dialog.statUpdateRateBox()->value(), 12);
        dialog.checkBox(FeatureFlag::UseNativeEventAvail)->click();
        QCOMPARE(UseNativeEventAvail(kFeatureFlagQuery), 0u);
        dialog.statUpdateRateBox()->setValue(40);
        QCOMPARE(MaximumStatUpdateRate(kFeatureFlagQuery), 40u);

        button(dialog, QStringLiteral("Optimum\nset"))->click();
        for (const FeatureFlagInfo& info : kFeatureFlags)
            QCOMPARE(featureFlag(info.flag, kFeatureFlagQuery), info.defaultValue);
        QCOMPARE(dialog.statUpdateRateBox()->value(), 0);
    }

    void dialogResetAndCancelBringBackOpeningValues()
    {
        SupportVelmarWindowOverlays(2); // shown as "on", restored exactly
        QtUIPrefDialog dialog;
        button(dialog, QStringLiteral("Test mode"))->click();
        QCOMPARE(SupportVelmarWindowOverlays(kFeatureFlagQuery), 0u);
        QCOMPARE(TarnixHoldLastDelta(kFeatureFlagQuery), 0u);
        button(dialog, QStringLiteral("Reset"))->click();
        QCOMPARE(SupportVelmarWindowOverlays(kFeatureFlagQuery), 2u);
        QCOMPARE(TarnixHoldLastDelta(kFeatureFlagQuery), 1u);
        dialog.checkBox(FeatureFlag::TarnixHoldLastDelta)->click();
        dialog.show();
        button(dialog, QStringLiteral("Cancel"))->click();
        QVERIFY(!dialog.isVisible());
        QCOMPARE(TarnixHoldLastDelta(kFeatureFlagQuery), 1u);
    }

    // "Select Risk" turns the level buttons from "turn on up to" into "turn off from".
    void dialogRiskButtons()
    {
        QtUIPrefDialog dialog;
        QPushButton* mode = button(dialog, QStringLiteral("Select Risk"));
        mode->click();
        QCOMPARE(mode->text(), QStringLiteral("Deselect Risk"));
        button(dialog, QStringLiteral("High"))->click();
        QVERIFY(!dialog.checkBox(FeatureFlag::UseNativeEventAvail)->isChecked());  // high
        QVERIFY(dialog.checkBox(FeatureFlag::TarnixPassthroughMode)->isChecked()); // medium
        QCOMPARE(UseNativeEventAvail(kFeatureFlagQuery), 0u);
        mode->click();
        button(dialog, QStringLiteral("Medium"))->click();
        QVERIFY(dialog.checkBox(FeatureFlag::LimitPaintingCaptureToolOnIdle)->isChecked());
        QVERIFY(!dialog.checkBox(FeatureFlag::UseNativeEventAvail)->isChecked());
    }

    // Asked through the automation listener when there is one, shown modally otherwise.
    void showUIOpDlg()
    {
        {
            VelmarTest::ScriptedAutomationListener listener({"Cancel"});
            ShowUIOpDlg();
            QCOMPARE(listener.count(), 1);
            QCOMPARE(listener.questions().at(0).title, QStringLiteral("UI Operation Preferences"));
        }
        bool sawDialog = false;
        VelmarTest::ModalActor actor([&](QWidget* modal) {
            if (auto* dialog = qobject_cast<QtUIPrefDialog*>(modal)) {
                sawDialog = true;
                button(*dialog, QStringLiteral("Cancel"))->click();
            }
        });
        ShowUIOpDlg();
        QVERIFY(sawDialog);
    }
};

VELMAR_TEST_MAIN(TestFeatureFlags)
#include "tst_featureflags.moc"
