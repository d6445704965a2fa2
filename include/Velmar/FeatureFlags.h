// Feature flags that select older or newer behaviours, and their preferences dialog.
//
// Every flag is a function of the same shape: pass kFeatureFlagQuery (0xFFFFFFFF) to read the
// value, anything else to set it. Values are read from the settings store once per process
// and cached; a set writes through to the store at once. The names are the settings keys.
#pragma once

#include <Velmar/MacTypes.h>

namespace Velmar {

inline constexpr UInt32 kFeatureFlagQuery = 0xFFFFFFFF;

VELMAR_EXPORT UInt32 UseNativeEventAvail(UInt32 newValue);
VELMAR_EXPORT UInt32 UseEventAvailInCheckForEvent(UInt32 newValue);
VELMAR_EXPORT UInt32 EnableLooperFiltering(UInt32 newValue);
VELMAR_EXPORT UInt32 EnableDirectQtDrawing(UInt32 newValue);
VELMAR_EXPORT UInt32 SupportVelmarWindowOverlays(UInt32 newValue);
VELMAR_EXPORT UInt32 ReportPaintEventFrequency(UInt32 newValue);
VELMAR_EXPORT UInt32 MaximumStatUpdateRate(UInt32 newValue); // ticks
VELMAR_EXPORT UInt32 AlwaysProcessEventsInReceiveNextEvent(UInt32 newValue);
// Three "r": the key already stored on users' machines.
VELMAR_EXPORT UInt32 DeferrredDeleteInProcessNonCarbonEvents(UInt32 newValue);
VELMAR_EXPORT UInt32 PendingEventsDelayIdleProcessing(UInt32 newValue);
VELMAR_EXPORT UInt32 MouseDownDelaysIdleProcessing(UInt32 newValue);
VELMAR_EXPORT UInt32 LimitPaintingViewerOnIdle(UInt32 newValue);
VELMAR_EXPORT UInt32 LimitPaintingSmartToolOnIdle(UInt32 newValue);
VELMAR_EXPORT UInt32 LimitPaintingAudioMetersOnIdle(UInt32 newValue);
VELMAR_EXPORT UInt32 LimitPaintingCaptureToolOnIdle(UInt32 newValue);
VELMAR_EXPORT UInt32 LimitDrawingWithWindowVisibleRegion(UInt32 newValue);
VELMAR_EXPORT UInt32 MouseClickStopsPlayLikeIn55(UInt32 newValue);
VELMAR_EXPORT UInt32 CheckForUserEventBehavesLikeIn55WithoutNullEvent(UInt32 newValue);
VELMAR_EXPORT UInt32 SupportLegacyMacEventProcessing(UInt32 newValue);
VELMAR_EXPORT UInt32 DontCallMainEventLoopCallbacksFromWNE(UInt32 newValue);
VELMAR_EXPORT UInt32 QWebSettingsPluginsEnabled(UInt32 newValue);
VELMAR_EXPORT UInt32 TarnixPassthroughMode(UInt32 newValue);
VELMAR_EXPORT UInt32 CCDontCallDisposePlayerCacheInSetEffectDirty(UInt32 newValue);
VELMAR_EXPORT UInt32 CCKeepLumo1VectorScopeEffectsLoaded(UInt32 newValue);
VELMAR_EXPORT UInt32 CCOnlyUpdateCurrentMonitor(UInt32 newValue);
VELMAR_EXPORT UInt32 CCFastScrubCurrentMonitor(UInt32 newValue);
VELMAR_EXPORT UInt32 TarnixHoldLastDelta(UInt32 newValue);

// Opens the preferences dialog for the flags and runs it modally.
VELMAR_EXPORT void ShowUIOpDlg();

} // namespace Velmar
