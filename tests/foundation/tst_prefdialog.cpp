// The preferences dialog: its texts, and what its buttons do to the flags.
#include "TestSupport.h"

#include <Velmar/FeatureFlags.h>

#include "foundation/PrefDialog.h"

#include <QCheckBox>
#include <QGroupBox>
#include <QLabel>
#include <QPushButton>
#include <QSettings>
#include <QSpinBox>

using namespace Velmar;
using Private::FeatureFlag;

namespace {

QPushButton* button(QtUIPrefDialog& dialog, const QString& text)
{
    for (QPushButton* b : dialog.findChildren<QPushButton*>()) {
        if (b->text() == text)
            return b;
    }
    return nullptr;
}

QSettings store()
{
    return QSettings(QLatin1String(Private::kSettingsOrganization),
                     QLatin1String(Private::kSettingsApplication));
}

} // namespace

class TestPrefDialog : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init()
    {
        store().clear();
        Private::resetFeatureFlagCache();
    }

    void textsAndWidgets()
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
        for (const char* text : {"Select Risk", "Medium", "High", "Test mode", "Optimum\nset",
                                 "Reset", "Cancel"})
            QVERIFY2(button(dialog, QLatin1String(text)), text);

        bool rateLabel = false;
        for (QLabel* l : dialog.findChildren<QLabel*>())
            rateLabel |= l->text() == QStringLiteral("Maximum progress refresh rate (ticks, 60 ticks/sec):");
        QVERIFY(rateLabel);

        // Every behaviour switch has a box, named after its flag; the diagnostics counter and
        // the refresh rate have none.
        const auto boxes = dialog.findChildren<QCheckBox*>();
        QCOMPARE(boxes.size(), 25);
        QVERIFY(!dialog.checkBox(FeatureFlag::ReportPaintEventFrequency));
        QCOMPARE(dialog.checkBox(FeatureFlag::DeferrredDeleteInProcessNonCarbonEvents)->objectName(),
                 QStringLiteral("DeferrredDeleteInProcessNonCarbonEvents"));
        QCOMPARE(boxes.first()->objectName(), QStringLiteral("LimitPaintingViewerOnIdle"));
        QCOMPARE(boxes.last()->objectName(), QStringLiteral("TarnixHoldLastDelta"));
    }

    void showsStoredValuesAndWritesThrough()
    {
        EnableDirectQtDrawing(1);
        MaximumStatUpdateRate(12);
        QtUIPrefDialog dialog;
        QVERIFY(dialog.checkBox(FeatureFlag::EnableDirectQtDrawing)->isChecked());
        QVERIFY(!dialog.checkBox(FeatureFlag::LimitPaintingCaptureToolOnIdle)->isChecked());
        QCOMPARE(dialog.statUpdateRateBox()->value(), 12);

        dialog.checkBox(FeatureFlag::UseNativeEventAvail)->click();
        QCOMPARE(UseNativeEventAvail(kFeatureFlagQuery), 0u);
        QCOMPARE(store().value(QStringLiteral("UseNativeEventAvail")).toUInt(), 0u);
        dialog.statUpdateRateBox()->setValue(40);
        QCOMPARE(MaximumStatUpdateRate(kFeatureFlagQuery), 40u);
    }

    void optimumSetRestoresDefaults()
    {
        EnableDirectQtDrawing(1);
        SupportLegacyMacEventProcessing(0);
        MaximumStatUpdateRate(30);
        QtUIPrefDialog dialog;
        button(dialog, QStringLiteral("Optimum\nset"))->click();
        for (const Private::FeatureFlagInfo& info : Private::kFeatureFlags) {
            if (QCheckBox* box = dialog.checkBox(info.flag)) {
                QCOMPARE(box->isChecked(), info.defaultValue != 0);
                QCOMPARE(Private::featureFlag(info.flag, kFeatureFlagQuery), info.defaultValue);
            }
        }
        QCOMPARE(dialog.statUpdateRateBox()->value(), 0);
        QCOMPARE(MaximumStatUpdateRate(kFeatureFlagQuery), 0u);
    }

    void resetAndCancelBringBackOpeningValues()
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

    void riskButtons()
    {
        QtUIPrefDialog dialog;
        QPushButton* mode = button(dialog, QStringLiteral("Select Risk"));
        mode->click();
        QCOMPARE(mode->text(), QStringLiteral("Deselect Risk"));
        button(dialog, QStringLiteral("High"))->click();
        QVERIFY(!dialog.checkBox(FeatureFlag::UseNativeEventAvail)->isChecked());   // high
        QVERIFY(dialog.checkBox(FeatureFlag::TarnixPassthroughMode)->isChecked());  // medium
        QCOMPARE(UseNativeEventAvail(kFeatureFlagQuery), 0u);

        mode->click();
        QCOMPARE(mode->text(), QStringLiteral("Select Risk"));
        button(dialog, QStringLiteral("Medium"))->click();
        QVERIFY(dialog.checkBox(FeatureFlag::LimitPaintingCaptureToolOnIdle)->isChecked());
        QVERIFY(!dialog.checkBox(FeatureFlag::UseNativeEventAvail)->isChecked());
    }

    void showUIOpDlgAsksTheListener()
    {
        VelmarTest::ScriptedAutomationListener listener({"Cancel"});
        ShowUIOpDlg();
        QCOMPARE(listener.count(), 1);
        QCOMPARE(listener.questions().at(0).title, QStringLiteral("UI Operation Preferences"));
    }

    void showUIOpDlgRunsModally()
    {
        bool sawDialog = false;
        VelmarTest::ModalActor actor([&](QWidget* modal) {
            sawDialog = qobject_cast<QtUIPrefDialog*>(modal) != nullptr;
            if (auto* dialog = qobject_cast<QtUIPrefDialog*>(modal))
                button(*dialog, QStringLiteral("Cancel"))->click();
        });
        ShowUIOpDlg();
        QVERIFY(sawDialog);
    }
};

VELMAR_TEST_MAIN(TestPrefDialog)
#include "tst_prefdialog.moc"
