// The inspector's switches: one row each, read and set through the library's own state;
// the two settings rows are also stored, so that the next start begins with them.
#pragma once

#include <span>

namespace Velmar::Private::Inspector {

struct Switch {
    const char* label;
    const char* settingsKey; // null: for this process only
    const char* toolTip;
    bool (*get)();
    void (*set)(bool on);
};

// In the order the panel shows them.
std::span<const Switch> switches();
// Sets the switch and stores it when it is a setting.
void applySwitch(const Switch& row, bool on);

// Where the settings rows live: organisation "Tessel Technology", application "Velmar".
inline constexpr const char* kSettingsOrganization = "Tessel Technology";
inline constexpr const char* kSettingsApplication = "Velmar";

} // namespace Velmar::Private::Inspector
