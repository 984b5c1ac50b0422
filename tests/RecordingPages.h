// Recording hosts of each page, generated from the pages' attribute tables.
#pragma once

#include "PageRecorder.h"

#include "ZEP2DBaseOptAnnotFrm.h"
#include "ZEP2DBaseOptDisplayFrm.h"
#include "ZEP2DBaseOptGalFrm.h"
#include "ZEP2DBaseOptGeoFrm.h"
#include "ZEP2DBaseOptGridFrm.h"
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

// A page built and initialised on iParent, as the host does it.
template <class Page> Page* OpenPage(HookScript& iScript, ZEPDialog* iParent) {
  auto* page = new Page(iScript, iParent);
  page->Build();
  page->Initialize();
  return page;
}

// The annotation page: the legend table layout context is the script's "LegendContext" text.
class RecordingAnnotPage : public Recording<ZEP2DBaseOptAnnotFrm> {
public:
  RecordingAnnotPage(HookScript& iScript, ZEPDialog* iParent)
      : Recording<ZEP2DBaseOptAnnotFrm>(iScript, iParent, "AnnotationPage") {}

protected:
#define ZEP_SETTING(Name, Kind) ZEP_RECORD_SETTING_HOOKS(ZEP2DBaseOptAnnotFrm, Name, Kind)
#include "ZEP2DBaseOptAnnotFrm.def"
#undef ZEP_SETTING
  ZEPString GetLegendTableLayoutContext() override {
    auto it = _script.texts.find("LegendContext");
    return it == _script.texts.end() ? ZEPString("DrwLegend") : ZEPString(it->second);
  }
};

// The display page: layout predicates from the script's options (every frame by default);
// Build places the frames from the script's "FirstRow" and, unless "WithTrackHistory" is 0,
// allows the track history check. The row after the last frame is kept in nextRow.
class RecordingDisplayPage : public Recording<ZEP2DBaseOptDisplayFrm> {
public:
  RecordingDisplayPage(HookScript& iScript, ZEPDialog* iParent)
      : Recording<ZEP2DBaseOptDisplayFrm>(iScript, iParent, "DisplayPage") {}
  void Build() {
    nextRow = static_cast<int>(_script.Option("FirstRow", 0));
    ZEP2DBaseOptDisplayFrm::Build(nextRow,
                                  static_cast<unsigned char>(_script.Option("WithTrackHistory", 1)));
  }
  int nextRow = 0;

protected:
#define ZEP_SETTING(Name, Kind) ZEP_RECORD_SETTING_HOOKS(ZEP2DBaseOptDisplayFrm, Name, Kind)
#include "ZEP2DBaseOptDisplayFrm.def"
#undef ZEP_SETTING
  unsigned char WithFrmVisualization() override { return Predicate("WithFrmVisualization"); }
  unsigned char WithFrmGeometries() override { return Predicate("WithFrmGeometries"); }
  unsigned char WithFrmCallouts() override { return Predicate("WithFrmCallouts"); }
  unsigned char WithFrmWelding() override { return Predicate("WithFrmWelding"); }
  unsigned char WithFrmPatterns() override { return Predicate("WithFrmPatterns"); }
  unsigned char WithFrmCapping() override { return Predicate("WithFrmCapping"); }

private:
  unsigned char Predicate(const char* iName) { return _script.Option(iName, 1) ? 1 : 0; }
};
