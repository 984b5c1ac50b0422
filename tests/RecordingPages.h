// Recording hosts of each page, generated from the pages' attribute tables.
#pragma once

#include "PageRecorder.h"

#include "ZEP2DBaseOptGalFrm.h"
#include "ZEP2DBaseOptGeoFrm.h"
#include "ZEP2DBaseOptGridFrm.h"
#include "ZEP2DBaseOptMainFrm.h"
#include "ZEP2DBasePrimaryViewFrm.h"

class RecordingGridPage : public Recording<ZEP2DBaseOptGridFrm> {
public:
  RecordingGridPage(HookScript& iScript, ZEPDialog* iParent)
      : Recording<ZEP2DBaseOptGridFrm>(iScript, iParent, "GridPage") {}

protected:
#define ZEP_SETTING(Name, Kind) ZEP_RECORD_SETTING_HOOKS(ZEP2DBaseOptGridFrm, Name, Kind)
#include "ZEP2DBaseOptGridFrm.def"
#undef ZEP_SETTING
};

class RecordingGalPage : public Recording<ZEP2DBaseOptGalFrm> {
public:
  RecordingGalPage(HookScript& iScript, ZEPDialog* iParent)
      : Recording<ZEP2DBaseOptGalFrm>(iScript, iParent, "GeneralPage") {}

protected:
#define ZEP_SETTING(Name, Kind) ZEP_RECORD_SETTING_HOOKS(ZEP2DBaseOptGalFrm, Name, Kind)
#include "ZEP2DBaseOptGalFrm.def"
#undef ZEP_SETTING
};

class RecordingPrimaryViewPage : public Recording<ZEP2DBasePrimaryViewFrm> {
public:
  RecordingPrimaryViewPage(HookScript& iScript, ZEPDialog* iParent)
      : Recording<ZEP2DBasePrimaryViewFrm>(iScript, iParent) {}

protected:
#define ZEP_SETTING(Name, Kind) ZEP_RECORD_SETTING_HOOKS(ZEP2DBasePrimaryViewFrm, Name, Kind)
#include "ZEP2DBasePrimaryViewFrm.def"
#undef ZEP_SETTING
  ZEPString GetFrameIconName() override { return "I_PrimaryView"; }
};

// The geometry page embeds a recording grid page on the same script, unless the script's
// "CreateGridFrame" option is 0.
class RecordingGeoPage : public Recording<ZEP2DBaseOptGeoFrm> {
public:
  RecordingGeoPage(HookScript& iScript, ZEPDialog* iParent)
      : Recording<ZEP2DBaseOptGeoFrm>(iScript, iParent, "GeometryPage") {}

protected:
#define ZEP_SETTING(Name, Kind) ZEP_RECORD_SETTING_HOOKS(ZEP2DBaseOptGeoFrm, Name, Kind)
#include "ZEP2DBaseOptGeoFrm.def"
#undef ZEP_SETTING
  ZEP2DBaseOptGridFrm* CreateGridFrame() override {
    return _script.Option("CreateGridFrame", 1) ? new RecordingGridPage(_script, this) : nullptr;
  }
};

// The main page answers its icon and default standard from the script's "GetFrameIconName"
// and "GetDefaultStandardName" answers.
class RecordingMainPage : public Recording<ZEP2DBaseOptMainFrm> {
public:
  RecordingMainPage(HookScript& iScript, ZEPDialog* iParent)
      : Recording<ZEP2DBaseOptMainFrm>(iScript, iParent, "MainPage") {}

protected:
  ZEPString GetFrameIconName() override { return _script.Answer("GetFrameIconName"); }
  ZEPUnicodeString GetDefaultStandardName() override {
    return _script.Answer("GetDefaultStandardName");
  }
#define ZEP_SETTING(Name, Kind) ZEP_RECORD_SETTING_HOOKS(ZEP2DBaseOptMainFrm, Name, Kind)
#include "ZEP2DBaseOptMainFrm.def"
#undef ZEP_SETTING
};

// A page built and initialised on iParent, as the host does it.
template <class Page> Page* OpenPage(HookScript& iScript, ZEPDialog* iParent) {
  auto* page = new Page(iScript, iParent);
  page->Build();
  page->Initialize();
  return page;
}
