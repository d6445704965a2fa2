/* Every classic header: for programs whose compilers included everything by default (the
   build gives it as a prefix header). */
#ifndef VELMAR_CLASSIC_TOOLBOX_H
#define VELMAR_CLASSIC_TOOLBOX_H
#include "Types.h"
#include "Memory.h"
#include "OSUtils.h"
#include "ToolUtils.h"
#include "TextUtils.h"
#include "Quickdraw.h"
#include "Fonts.h"
#include "Icons.h"
#include "Events.h"
#include "Controls.h"
#include "Windows.h"
#include "Menus.h"
#include "TextEdit.h"
#include "Resources.h"
#include "Dialogs.h"
#include "Sound.h"
#include "Devices.h"
#include "Traps.h"
#endif
