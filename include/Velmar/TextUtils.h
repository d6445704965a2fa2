// Conversions between Toolbox and Qt values, Pascal-string utilities.
#pragma once

#include <Velmar/MacTypes.h>
