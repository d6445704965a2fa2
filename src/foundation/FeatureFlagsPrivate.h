// The generic machinery behind the exported feature-flag functions.
#pragma once

#include <Velmar/MacTypes.h>

#include "foundation/FeatureFlagTable.h"

#include <QString>

#include <span>

namespace Velmar::Private {

enum class FeatureFlag : int {
#define VELMAR_FLAG_ENUM(name, defaultValue, risk) name,
    VELMAR_FEATURE_FLAG_LIST(VELMAR_FLAG_ENUM)
#undef VELMAR_FLAG_ENUM
};

struct FeatureFlagInfo {
    FeatureFlag flag;
    const char* name; // also the settings key
    UInt32 defaultValue;
    int risk; // 0 low, 1 medium, 2 high, -1 not a behaviour switch
};

inline constexpr FeatureFlagInfo kFeatureFlags[] = {
#define VELMAR_FLAG_INFO(name, defaultValue, risk)                                          \
    {FeatureFlag::name, #name, defaultValue, risk},
    VELMAR_FEATURE_FLAG_LIST(VELMAR_FLAG_INFO)
#undef VELMAR_FLAG_INFO
};

inline constexpr int kPreferencesVersion = 19;
inline constexpr const char* kPreferencesVersionKey = "CurrentPreferencesVersion";
inline constexpr const char* kSettingsOrganization = "Tessel Technology";
inline constexpr const char* kSettingsApplication = "Editor UI Optimizations";

const FeatureFlagInfo& featureFlagInfo(FeatureFlag flag);

// Reads (newValue == kFeatureFlagQuery) or sets one flag; returns its value.
UInt32 featureFlag(FeatureFlag flag, UInt32 newValue);

// Forgets every cached value and the version check, as in a fresh process. Tests only.
void resetFeatureFlagCache();

} // namespace Velmar::Private
