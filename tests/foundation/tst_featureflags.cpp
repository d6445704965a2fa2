// Feature flags: defaults, the store's version rule, caching and write-through.
#include "TestSupport.h"

#include <Velmar/FeatureFlags.h>

#include "foundation/FeatureFlagsPrivate.h"

#include <QSettings>

using namespace Velmar;
using namespace Velmar::Private;

namespace {

QSettings store()
{
    return QSettings(QLatin1String(kSettingsOrganization), QLatin1String(kSettingsApplication));
}

using FlagFunction = UInt32 (*)(UInt32);

struct Exported {
    FlagFunction function;
    const char* name;
};

// The exported functions, listed by hand so that a wrong table entry shows up.
#define FLAG(function) Exported{&function, #function}
const Exported kExported[] = {
    FLAG(UseNativeEventAvail), FLAG(UseEventAvailInCheckForEvent), FLAG(EnableLooperFiltering),
    FLAG(EnableDirectQtDrawing), FLAG(SupportVelmarWindowOverlays), FLAG(ReportPaintEventFrequency),
    FLAG(MaximumStatUpdateRate), FLAG(AlwaysProcessEventsInReceiveNextEvent),
    FLAG(DeferrredDeleteInProcessNonCarbonEvents), FLAG(PendingEventsDelayIdleProcessing),
    FLAG(MouseDownDelaysIdleProcessing), FLAG(LimitPaintingViewerOnIdle),
    FLAG(LimitPaintingSmartToolOnIdle), FLAG(LimitPaintingAudioMetersOnIdle),
    FLAG(LimitPaintingCaptureToolOnIdle), FLAG(LimitDrawingWithWindowVisibleRegion),
    FLAG(MouseClickStopsPlayLikeIn55), FLAG(CheckForUserEventBehavesLikeIn55WithoutNullEvent),
    FLAG(SupportLegacyMacEventProcessing), FLAG(DontCallMainEventLoopCallbacksFromWNE),
    FLAG(QWebSettingsPluginsEnabled), FLAG(TarnixPassthroughMode),
    FLAG(CCDontCallDisposePlayerCacheInSetEffectDirty), FLAG(CCKeepLumo1VectorScopeEffectsLoaded),
    FLAG(CCOnlyUpdateCurrentMonitor), FLAG(CCFastScrubCurrentMonitor), FLAG(TarnixHoldLastDelta),
};
#undef FLAG

// Defaults that are 0; every other flag defaults to 1.
const QStringList kZeroDefaults{
    QStringLiteral("EnableDirectQtDrawing"), QStringLiteral("ReportPaintEventFrequency"),
    QStringLiteral("MaximumStatUpdateRate"), QStringLiteral("LimitPaintingCaptureToolOnIdle")};

} // namespace

class TestFeatureFlags : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init()
    {
        store().clear();
        resetFeatureFlagCache();
    }

    void cleanStoreGetsDefaults()
    {
        QCOMPARE(std::size(kExported), std::size(kFeatureFlags));
        for (const Exported& e : kExported) {
            const UInt32 expected = kZeroDefaults.contains(QLatin1String(e.name)) ? 0 : 1;
            QCOMPARE(e.function(kFeatureFlagQuery), expected);
            QSettings s = store();
            QVERIFY2(s.contains(QLatin1String(e.name)), e.name);
            QCOMPARE(s.value(QLatin1String(e.name)).toUInt(), expected);
        }
        QCOMPARE(store().value(QLatin1String(kPreferencesVersionKey)).toInt(), 19);
    }

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

        // Read once per process: later edits of the store are not seen.
        store().setValue(QStringLiteral("MaximumStatUpdateRate"), 45);
        QCOMPARE(MaximumStatUpdateRate(kFeatureFlagQuery), 30u);
    }

    // A store written by another version (or by none) is wiped and refilled with defaults.
    void otherVersionWipesStore()
    {
        for (const QVariant& version : {QVariant(18), QVariant(20), QVariant(), QVariant(QStringLiteral("nineteen"))}) {
            init();
            {
                QSettings s = store();
                if (version.isValid())
                    s.setValue(QLatin1String(kPreferencesVersionKey), version);
                s.setValue(QStringLiteral("UseNativeEventAvail"), 0);
                s.setValue(QStringLiteral("EnableDirectQtDrawing"), 1);
                s.setValue(QStringLiteral("SomeOldKey"), 5);
            }
            QCOMPARE(EnableLooperFiltering(kFeatureFlagQuery), 1u);
            QSettings s = store();
            QVERIFY(!s.contains(QStringLiteral("SomeOldKey")));
            QCOMPARE(s.value(QLatin1String(kPreferencesVersionKey)).toInt(), 19);
            QCOMPARE(UseNativeEventAvail(kFeatureFlagQuery), 1u);
            QCOMPARE(EnableDirectQtDrawing(kFeatureFlagQuery), 0u);
        }
    }

    void setWritesThroughOnlyOnChange()
    {
        QCOMPARE(SupportLegacyMacEventProcessing(0), 0u);
        QCOMPARE(store().value(QStringLiteral("SupportLegacyMacEventProcessing")).toUInt(), 0u);
        QCOMPARE(SupportLegacyMacEventProcessing(kFeatureFlagQuery), 0u);

        // Someone else edits the store; setting the cached value again must not write.
        store().setValue(QStringLiteral("SupportLegacyMacEventProcessing"), 7);
        QCOMPARE(SupportLegacyMacEventProcessing(0), 0u);
        QCOMPARE(store().value(QStringLiteral("SupportLegacyMacEventProcessing")).toUInt(), 7u);

        QCOMPARE(SupportLegacyMacEventProcessing(2), 2u);
        QCOMPARE(store().value(QStringLiteral("SupportLegacyMacEventProcessing")).toUInt(), 2u);

        // A fresh process reads what was written.
        resetFeatureFlagCache();
        QCOMPARE(SupportLegacyMacEventProcessing(kFeatureFlagQuery), 2u);
    }

    void versionCheckedOncePerProcess()
    {
        QCOMPARE(TarnixHoldLastDelta(0), 0u);
        // A second flag after the first must not wipe again.
        QCOMPARE(CCFastScrubCurrentMonitor(kFeatureFlagQuery), 1u);
        QCOMPARE(store().value(QStringLiteral("TarnixHoldLastDelta")).toUInt(), 0u);
    }
};

VELMAR_TEST_MAIN(TestFeatureFlags)
#include "tst_featureflags.moc"
