// The host framework stand-in: everything the drafting settings module calls.
#pragma once

#include "ZEPHostTypes.h"
#include "ZEPSystem.h"
#include "ZEPDialog.h"
#include "ZEPSettings.h"
#include "ZEPDlgDriver.h"
#include "ZEPCkeUnits.h"
#include "ZEPScalesServices.h"
#include "ZEPStdServices.h"
#include "ZEPSketcherSettings.h"
#include "ZEPMessageBox.h"
#include "ZEPPLMServices.h"
#include "ZEPDfuScaleToolbox.h"
#include "ZEPVidDialogs.h"
