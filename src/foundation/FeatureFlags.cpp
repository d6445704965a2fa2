// Feature flags: read once from the settings store, cached, written through on change.
#include <Velmar/FeatureFlags.h>

#include "foundation/FeatureFlagsPrivate.h"

#include <QSettings>

#include <array>
#include <type_traits>

namespace Velmar {

namespace Private {

namespace {

constexpr UInt32 kUnread = 0xFFFFFFFF;
constexpr std::size_t kFlagCount = std::size(kFeatureFlags);

std::array<UInt32, kFlagCount> makeUnreadCache()
{
    std::array<UInt32, kFlagCount> cache;
    cache.fill(kUnread);
    return cache;
}

std::array<UInt32, kFlagCount> gFlagCache = makeUnreadCache();
bool gPreferencesVersionVerified = false;

// A store written by another preferences version starts over.
void verifyPreferencesVersion(QSettings& settings)
{
    if (gPreferencesVersionVerified)
        return;
    gPreferencesVersionVerified = true;
    const QVariant version = settings.value(QLatin1String(kPreferencesVersionKey));
    bool isNumber = false;
    if (version.isValid() && version.toInt(&isNumber) == kPreferencesVersion && isNumber)
        return;
    settings.clear();
    settings.setValue(QLatin1String(kPreferencesVersionKey), kPreferencesVersion);
}

} // namespace

const FeatureFlagInfo& featureFlagInfo(FeatureFlag flag)
{
    return kFeatureFlags[std::size_t(flag)];
}

UInt32 featureFlag(FeatureFlag flag, UInt32 newValue)
{
    UInt32& cache = gFlagCache[std::size_t(flag)];
    // Known, and not changing: the settings store need not be opened.
    if (cache != kUnread && (newValue == kFeatureFlagQuery || newValue == cache))
        return cache;

    const FeatureFlagInfo& info = featureFlagInfo(flag);
    const QString key = QLatin1String(info.name);
    QSettings settings{QLatin1String(kSettingsOrganization), QLatin1String(kSettingsApplication)};
    verifyPreferencesVersion(settings);

    if (cache == kUnread) {
        cache = info.defaultValue;
        if (settings.contains(key))
            cache = settings.value(key).toUInt();
        else
            settings.setValue(key, info.defaultValue);
    }
    if (newValue != kFeatureFlagQuery && newValue != cache) {
        cache = newValue;
        settings.setValue(key, newValue);
    }
    return cache;
}

void resetFeatureFlagCache()
{
    gFlagCache = makeUnreadCache();
    gPreferencesVersionVerified = false;
}

} // namespace Private

// One thin exported function per flag; the declarations in the public header must match.
#define VELMAR_FLAG_FUNCTION(name, defaultValue, risk)                                      \
    static_assert(std::is_same_v<decltype(&name), UInt32 (*)(UInt32)>);                     \
    UInt32 name(UInt32 newValue)                                                            \
    {                                                                                       \
        return Private::featureFlag(Private::FeatureFlag::name, newValue);                  \
    }
VELMAR_FEATURE_FLAG_LIST(VELMAR_FLAG_FUNCTION)
#undef VELMAR_FLAG_FUNCTION

} // namespace Velmar
