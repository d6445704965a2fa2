// The preferences dialog for the feature flags.
#pragma once

#include "foundation/FeatureFlagsPrivate.h"

#include <QDialog>
#include <QHash>

class QCheckBox;
class QPushButton;
class QSpinBox;

namespace Velmar {

// One check box per behaviour switch, grouped as the host's support staff know them, and
// a spin box for the progress refresh rate. Every change is written through to the flag at
// once; "Reset" brings back the values the dialog opened with and "Cancel" does the same
// and closes. "Select Risk" flips between selecting and deselecting ("Deselect Risk"); the
// "Medium" and "High" buttons then check or clear every switch of that risk level.
class QtUIPrefDialog : public QDialog {
    Q_OBJECT

public:
    explicit QtUIPrefDialog(QWidget* parent = nullptr);
    // The window title, also what an automation listener is asked under.
    static QString title();

    QCheckBox* checkBox(Private::FeatureFlag flag) const { return m_checkBoxes.value(int(flag)); }
    QSpinBox* statUpdateRateBox() const { return m_statUpdateRate; }

public Q_SLOTS:
    void setOptimum();      // every switch to its default, refresh rate 0
    void setTestMode();     // every switch off (the older behaviours), refresh rate 0
    void resetToOpening();  // the values the dialog opened with
    void reject() override; // resets, then closes

private:
    void toggleRiskMode();
    void applyRiskLevel(int risk);
    void showValues(const QHash<int, UInt32>& values);

    QHash<int, QCheckBox*> m_checkBoxes; // by FeatureFlag
    QSpinBox* m_statUpdateRate = nullptr;
    QPushButton* m_riskMode = nullptr;
    bool m_selecting = true;
    QHash<int, UInt32> m_openingValues; // by FeatureFlag, including the refresh rate
};

} // namespace Velmar
