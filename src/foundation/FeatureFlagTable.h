// The one list of feature flags: name (also the settings key), default, risk level
// (0 low, 1 medium, 2 high, -1 not a behaviour switch). Everything else is generated from it.
#pragma once

#define VELMAR_FEATURE_FLAG_LIST(X)                                                         \
    X(UseNativeEventAvail, 1, 2)                                                            \
    X(UseEventAvailInCheckForEvent, 1, 1)                                                   \
    X(EnableLooperFiltering, 1, 0)                                                          \
    X(EnableDirectQtDrawing, 0, 0)                                                          \
    X(SupportVelmarWindowOverlays, 1, 2)                                                    \
    X(ReportPaintEventFrequency, 0, -1)                                                     \
    X(MaximumStatUpdateRate, 0, -1)                                                         \
    X(AlwaysProcessEventsInReceiveNextEvent, 1, 1)                                          \
    X(DeferrredDeleteInProcessNonCarbonEvents, 1, 1)                                        \
    X(PendingEventsDelayIdleProcessing, 1, 1)                                               \
    X(MouseDownDelaysIdleProcessing, 1, 1)                                                  \
    X(LimitPaintingViewerOnIdle, 1, 2)                                                      \
    X(LimitPaintingSmartToolOnIdle, 1, 2)                                                   \
    X(LimitPaintingAudioMetersOnIdle, 1, 2)                                                 \
    X(LimitPaintingCaptureToolOnIdle, 0, 1)                                                 \
    X(LimitDrawingWithWindowVisibleRegion, 1, 2)                                            \
    X(MouseClickStopsPlayLikeIn55, 1, 1)                                                    \
    X(CheckForUserEventBehavesLikeIn55WithoutNullEvent, 1, 0)                               \
    X(SupportLegacyMacEventProcessing, 1, 2)                                                \
    X(DontCallMainEventLoopCallbacksFromWNE, 1, 1)                                          \
    X(QWebSettingsPluginsEnabled, 1, 2)                                                     \
    X(TarnixPassthroughMode, 1, 1)                                                          \
    X(CCDontCallDisposePlayerCacheInSetEffectDirty, 1, 0)                                   \
    X(CCKeepLumo1VectorScopeEffectsLoaded, 1, 1)                                            \
    X(CCOnlyUpdateCurrentMonitor, 1, 1)                                                     \
    X(CCFastScrubCurrentMonitor, 1, 0)                                                      \
    X(TarnixHoldLastDelta, 1, 1)
