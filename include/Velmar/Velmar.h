// Everything a host needs: include this one header and link Velmar::Velmar.
#pragma once

#include <Velmar/MacTypes.h>
#include <Velmar/MacErrors.h>
#include <Velmar/Diagnostics.h>
#include <Velmar/TextUtils.h>
#include <Velmar/HostEncoding.h>
#include <Velmar/HostCore.h>
#include <Velmar/HostShell.h>
#include <Velmar/Application.h>
#include <Velmar/FeatureFlags.h>
#include <Velmar/Events.h>
#include <Velmar/CarbonEvents.h>
#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/EventWaiting.h>
#include <Velmar/QtGrafPort.h>
#include <Velmar/QuickDraw.h>
#include <Velmar/QDRegions.h>
#include <Velmar/QDShapes.h>
#include <Velmar/QDText.h>
#include <Velmar/TextEdit.h>
#include <Velmar/AQtWindow.h>
#include <Velmar/AQtWinGDImage.h>
#include <Velmar/Windows.h>
#include <Velmar/Resources.h>
#include <Velmar/QDIcons.h>
#include <Velmar/Menus.h>
