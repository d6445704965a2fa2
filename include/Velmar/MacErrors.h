// Toolbox result codes returned by the library, under their published names.
#pragma once

#include <Velmar/MacTypes.h>

namespace Velmar {

enum : OSStatus {
    noErr = 0,
    unimpErr = -4,
    paramErr = -50,
    noTypeErr = -102,
    memFullErr = -108,
    nilHandleErr = -109,
    resNotFound = -192,

    errAECoercionFail = -1700,

    badDragRefErr = -1850,
    badDragItemErr = -1851,
    badDragFlavorErr = -1852,
    duplicateFlavorErr = -1853,
    cantGetFlavorErr = -1854,
    duplicateHandlerErr = -1855,
    handlerNotFoundErr = -1856,
    dragNotAcceptedErr = -1857,

    // Window bounds and region calls with a null rectangle or region, or an unsupported region code.
    errNullWindowArgument = -5246,
    errInvalidWindowPtr = -5600,
    errInvalidWindowRef = -5600,
    errWindowPropertyNotFound = -5604,

    menuNotFoundErr = -5620,
    menuItemNotFoundErr = -5622,
    menuInvalidErr = -5623,

    eventAlreadyPostedErr = -9860,
    eventTargetBusyErr = -9861,
    eventClassInvalidErr = -9862,
    eventClassIncorrectErr = -9864,
    eventHandlerAlreadyInstalledErr = -9866,
    eventInternalErr = -9868,
    eventKindIncorrectErr = -9869,
    eventParameterNotFoundErr = -9870,
    eventNotHandledErr = -9874,
    eventLoopTimedOutErr = -9875,
    eventLoopQuitErr = -9876,
    eventNotInQueueErr = -9877,
};

// Menu insertion keeps host menus that live under this ID at the end of the bar.
constexpr SInt16 kMenuBarAnchorID = -16490;

} // namespace Velmar
