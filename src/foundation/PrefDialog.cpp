#include "foundation/PrefDialog.h"

#include "foundation/DiagnosticsPrivate.h"

#include <Velmar/FeatureFlags.h>

#include <QApplication>
#include <QCheckBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QSpinBox>
#include <QVBoxLayout>

#include <functional>
#include <utility>

namespace Velmar {

namespace {

using Private::FeatureFlag;

struct PrefRow {
    FeatureFlag flag;
    const char* label;
    int group; // index into kGroupTitles
};

const char* const kGroupTitles[] = {
    "Draw less or less often",
    "Delays from \"idle\" processes",
    "Low-level event system",
    "Web settings",
    "Artist Color Improvements",
};

// The dialog's rows, top to bottom.
const PrefRow kRows[] = {
    {FeatureFlag::LimitPaintingViewerOnIdle, "Limit painting of the viewer on idle", 0},
    {FeatureFlag::LimitPaintingSmartToolOnIdle, "Limit painting of the smart tool on idle", 0},
    {FeatureFlag::LimitPaintingAudioMetersOnIdle, "Limit painting of the audio meters on idle", 0},
    {FeatureFlag::LimitPaintingCaptureToolOnIdle, "Limit painting of the capture tool on idle", 0},
    {FeatureFlag::LimitDrawingWithWindowVisibleRegion,
     "Limit drawing to the visible region of a window", 0},
    {FeatureFlag::MouseClickStopsPlayLikeIn55, "Mouse click stops play as in 5.5", 1},
    {FeatureFlag::CheckForUserEventBehavesLikeIn55WithoutNullEvent,
     "Check for user events as in 5.5, without null events", 1},
    {FeatureFlag::UseNativeEventAvail, "Look into the native event queue in EventAvail", 1},
    {FeatureFlag::UseEventAvailInCheckForEvent, "Use EventAvail when checking for events", 1},
    {FeatureFlag::PendingEventsDelayIdleProcessing, "Pending events delay idle processing", 1},
    {FeatureFlag::MouseDownDelaysIdleProcessing, "Mouse down delays idle processing", 1},
    {FeatureFlag::AlwaysProcessEventsInReceiveNextEvent,
     "Always process events in ReceiveNextEvent", 2},
    {FeatureFlag::DeferrredDeleteInProcessNonCarbonEvents,
     "Deferred delete while processing non-Carbon events", 2},
    {FeatureFlag::SupportLegacyMacEventProcessing, "Legacy Macintosh event processing", 2},
    {FeatureFlag::DontCallMainEventLoopCallbacksFromWNE,
     "Don't call main event loop callbacks from WaitNextEvent", 2},
    {FeatureFlag::EnableLooperFiltering, "Looper filtering", 2},
    {FeatureFlag::EnableDirectQtDrawing, "Direct drawing", 2},
    {FeatureFlag::SupportVelmarWindowOverlays, "Window overlays", 2},
    {FeatureFlag::QWebSettingsPluginsEnabled, "Enable web plug-ins", 3},
    {FeatureFlag::TarnixPassthroughMode, "Control surface pass-through mode", 4},
    {FeatureFlag::CCDontCallDisposePlayerCacheInSetEffectDirty,
     "Keep the player cache when an effect changes", 4},
    {FeatureFlag::CCKeepLumo1VectorScopeEffectsLoaded, "Keep vector scope effects loaded", 4},
    {FeatureFlag::CCOnlyUpdateCurrentMonitor, "Only update the current monitor", 4},
    {FeatureFlag::CCFastScrubCurrentMonitor, "Fast scrub in the current monitor", 4},
    {FeatureFlag::TarnixHoldLastDelta, "Control surface holds the last delta", 4},
};

const char* riskText(int risk)
{
    static const char* const kRisk[] = {"low risk", "medium risk", "high risk"};
    return (risk >= 0 && risk < 3) ? kRisk[risk] : "";
}

UInt32 currentValue(FeatureFlag flag)
{
    return Private::featureFlag(flag, kFeatureFlagQuery);
}

// Every flag at its default ("Optimum set") or off ("Test mode"); the refresh rate at 0.
QHash<int, UInt32> presetValues(bool defaults)
{
    QHash<int, UInt32> values;
    for (const Private::FeatureFlagInfo& info : Private::kFeatureFlags)
        values.insert(int(info.flag), defaults ? info.defaultValue : 0);
    values.insert(int(FeatureFlag::MaximumStatUpdateRate), 0);
    return values;
}

} // namespace

QString QtUIPrefDialog::title()
{
    return tr("UI Operation Preferences");
}

QtUIPrefDialog::QtUIPrefDialog(QWidget* parent)
    : QDialog(parent)
{
    setWindowTitle(title());
    auto* groupsColumn = new QVBoxLayout;
    QVBoxLayout* groupLayouts[std::size(kGroupTitles)];
    for (std::size_t g = 0; g < std::size(kGroupTitles); ++g) {
        auto* box = new QGroupBox(tr(kGroupTitles[g]), this);
        groupLayouts[g] = new QVBoxLayout(box);
        groupsColumn->addWidget(box);
    }

    for (const PrefRow& row : kRows) {
        const Private::FeatureFlagInfo& info = Private::featureFlagInfo(row.flag);
        auto* check = new QCheckBox(tr(row.label), this);
        check->setObjectName(QLatin1String(info.name));
        check->setToolTip(QStringLiteral("%1 (%2)").arg(QLatin1String(info.name),
                                                       QLatin1String(riskText(info.risk))));
        const UInt32 value = currentValue(row.flag);
        m_openingValues.insert(int(row.flag), value);
        check->setChecked(value != 0);
        connect(check, &QCheckBox::toggled, this, [flag = row.flag](bool on) {
            Private::featureFlag(flag, on ? 1 : 0);
        });
        groupLayouts[row.group]->addWidget(check);
        m_checkBoxes.insert(int(row.flag), check);
    }

    // The refresh rate sits with the drawing switches.
    auto* rateRow = new QHBoxLayout;
    rateRow->addWidget(new QLabel(tr("Maximum progress refresh rate (ticks, 60 ticks/sec):"), this));
    m_statUpdateRate = new QSpinBox(this);
    m_statUpdateRate->setObjectName(QStringLiteral("MaximumStatUpdateRate"));
    m_statUpdateRate->setRange(0, 600);
    const UInt32 rate = currentValue(FeatureFlag::MaximumStatUpdateRate);
    m_openingValues.insert(int(FeatureFlag::MaximumStatUpdateRate), rate);
    m_statUpdateRate->setValue(int(qMin<UInt32>(rate, 600)));
    connect(m_statUpdateRate, &QSpinBox::valueChanged, this, [](int ticks) {
        Private::featureFlag(FeatureFlag::MaximumStatUpdateRate, UInt32(ticks));
    });
    rateRow->addWidget(m_statUpdateRate);
    groupLayouts[0]->addLayout(rateRow);

    // The buttons, top to bottom; the first flips the risk mode and shows which it is in.
    const std::pair<const char*, std::function<void()>> kButtons[] = {
        {QT_TR_NOOP("Select Risk"), [this] { toggleRiskMode(); }},
        {QT_TR_NOOP("Medium"), [this] { applyRiskLevel(1); }},
        {QT_TR_NOOP("High"), [this] { applyRiskLevel(2); }},
        {QT_TR_NOOP("Test mode"), [this] { setTestMode(); }},
        {QT_TR_NOOP("Optimum\nset"), [this] { setOptimum(); }},
        {QT_TR_NOOP("Reset"), [this] { resetToOpening(); }},
        {QT_TR_NOOP("Cancel"), [this] { reject(); }},
    };
    auto* buttons = new QVBoxLayout;
    for (const auto& [text, action] : kButtons) {
        auto* button = new QPushButton(tr(text), this);
        button->setAutoDefault(false);
        connect(button, &QPushButton::clicked, this, action);
        buttons->addWidget(button);
        if (!m_riskMode)
            m_riskMode = button;
    }
    buttons->addStretch();

    auto* top = new QHBoxLayout(this);
    top->addLayout(groupsColumn, 1);
    top->addLayout(buttons);
}

void QtUIPrefDialog::toggleRiskMode()
{
    m_selecting = !m_selecting;
    m_riskMode->setText(m_selecting ? tr("Select Risk") : tr("Deselect Risk"));
}

void QtUIPrefDialog::applyRiskLevel(int risk)
{
    for (const PrefRow& row : kRows) {
        if (Private::featureFlagInfo(row.flag).risk == risk)
            m_checkBoxes.value(int(row.flag))->setChecked(m_selecting);
    }
}

void QtUIPrefDialog::setOptimum()
{
    showValues(presetValues(true));
}

void QtUIPrefDialog::setTestMode()
{
    showValues(presetValues(false));
}

void QtUIPrefDialog::resetToOpening()
{
    showValues(m_openingValues);
}

void QtUIPrefDialog::reject()
{
    resetToOpening();
    QDialog::reject();
}

void QtUIPrefDialog::showValues(const QHash<int, UInt32>& values)
{
    // Written explicitly as well as shown: a stored 2 shows as "on" and would survive a
    // check box that stays checked, but a reset must bring the exact value back.
    for (auto it = m_checkBoxes.cbegin(); it != m_checkBoxes.cend(); ++it) {
        const UInt32 value = values.value(it.key());
        it.value()->setChecked(value != 0);
        Private::featureFlag(FeatureFlag(it.key()), value);
    }
    const UInt32 rate = values.value(int(FeatureFlag::MaximumStatUpdateRate));
    m_statUpdateRate->setValue(int(qMin<UInt32>(rate, 600)));
    Private::featureFlag(FeatureFlag::MaximumStatUpdateRate, rate);
}

void ShowUIOpDlg()
{
    // A scripted run never waits on the box: the listener's answer closes it unchanged.
    if (Private::askAutomationListener(QtUIPrefDialog::title(), QString(),
                                       QStringLiteral("OK|Cancel")))
        return;
    if (!qobject_cast<QApplication*>(QCoreApplication::instance())) {
        qWarning("ShowUIOpDlg: no application object");
        return;
    }
    QtUIPrefDialog dialog(QApplication::activeWindow());
    dialog.exec();
}

} // namespace Velmar
