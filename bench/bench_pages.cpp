// Page costs: building and initialising each page, and one user change reaching its hook.
#include "ZEP2DBaseOptAnnotFrm.h"
#include "ZEP2DBaseOptDisplayFrm.h"
#include "ZEP2DBaseOptGalFrm.h"
#include "ZEP2DBaseOptGeoFrm.h"
#include "ZEP2DBaseOptGridFrm.h"
#include "ZEP2DBasePrimaryViewFrm.h"

#include <benchmark/benchmark.h>

#include <string>
#include <vector>

namespace {
// A host whose hooks answer at once: what is measured is the page and the toolkit.
#define ZEP_SETTING(Name, Kind)                                                                     \
  long SetSys##Name(ZEP_SETPARAMS(Kind)) override {                                                 \
    ZEPHookDefaults::Ignore(ZEP_SETARGS(Kind));                                                     \
    ++_writes;                                                                                      \
    return S_OK;                                                                                    \
  }                                                                                                 \
  long GetSys##Name##Info(ZEPSettingInfo&) override { return S_OK; }

struct GridPage : ZEP2DBaseOptGridFrm {
  explicit GridPage(ZEPDialog* iParent) : ZEP2DBaseOptGridFrm(iParent, "GridPage") {}
  long _writes = 0;
#include "ZEP2DBaseOptGridFrm.def"
};
struct GalPage : ZEP2DBaseOptGalFrm {
  explicit GalPage(ZEPDialog* iParent) : ZEP2DBaseOptGalFrm(iParent, "GeneralPage") {}
  long _writes = 0;
#include "ZEP2DBaseOptGalFrm.def"
};
struct PrimaryViewPage : ZEP2DBasePrimaryViewFrm {
  explicit PrimaryViewPage(ZEPDialog* iParent) : ZEP2DBasePrimaryViewFrm(iParent) {}
  long _writes = 0;
  ZEPString GetFrameIconName() override { return "I_PrimaryView"; }
#include "ZEP2DBasePrimaryViewFrm.def"
};
struct GeoPage : ZEP2DBaseOptGeoFrm {
  explicit GeoPage(ZEPDialog* iParent) : ZEP2DBaseOptGeoFrm(iParent, "GeometryPage") {}
  long _writes = 0;
  ZEP2DBaseOptGridFrm* CreateGridFrame() override { return new GridPage(this); }
#include "ZEP2DBaseOptGeoFrm.def"
};
#undef ZEP_SETTING

template <class Page> void BuildAndInitialize(benchmark::State& state) {
  ZEPDlgWindow root(nullptr, "root", 0);
  for (auto _ : state) {
    auto* page = new Page(&root);
    page->Build();
    page->Initialize();
    benchmark::DoNotOptimize(page);
    delete page;
  }
}

template <class Page> void ClickToHook(benchmark::State& state, const char* iControl) {
  ZEPDlgWindow root(nullptr, "root", 0);
  auto* page = new Page(&root);
  page->Build();
  page->Initialize();
  ZEPDialog* control = ZEPDlgDriver::FindControl(page, iControl);
  for (auto _ : state) benchmark::DoNotOptimize(ZEPDlgDriver::Click(control));
  if (page->_writes != static_cast<long>(state.iterations())) state.SkipWithError("a click did not reach its hook");
}
} // namespace

BENCHMARK_TEMPLATE(BuildAndInitialize, GridPage);
BENCHMARK_TEMPLATE(BuildAndInitialize, GalPage);
BENCHMARK_TEMPLATE(BuildAndInitialize, PrimaryViewPage);
BENCHMARK_TEMPLATE(BuildAndInitialize, GeoPage);

// A sub-dialog as the user goes through it: press its button, tick a check, close it.
void GeoSubDialogRoundTrip(benchmark::State& state) {
  ZEPDlgWindow root(nullptr, "root", 0);
  auto* page = new GeoPage(&root);
  page->Build();
  page->Initialize();
  ZEPDialog* button = ZEPDlgDriver::Find(page, "smartPickPushButton");
  for (auto _ : state) {
    ZEPDlgDriver::Click(button);
    ZEPDialog* dialog = ZEPDlgDriver::Find(page, "geoSmartPick");
    ZEPDlgDriver::Click(ZEPDlgDriver::FindControl(dialog, "checkSmartPickHoriVerti"));
    ZEPDlgDriver::CloseDialog(dialog);
    ZEPDlgDriver::Idle();
  }
  if (page->_writes != static_cast<long>(state.iterations())) state.SkipWithError("a click did not reach its hook");
}
BENCHMARK(GeoSubDialogRoundTrip);
void GridClickSnap(benchmark::State& state) { ClickToHook<GridPage>(state, "checkSnap"); }
void GalClickViewFrame(benchmark::State& state) { ClickToHook<GalPage>(state, "checkViewFrame"); }
void PrimaryViewClickResize(benchmark::State& state) { ClickToHook<PrimaryViewPage>(state, "chkResizeViewBoxOn3D"); }
BENCHMARK(GridClickSnap);
BENCHMARK(GalClickViewFrame);
BENCHMARK(PrimaryViewClickResize);

// ---- annotation and display pages ----------------------------------------------------------------
namespace {
// As above; the info hooks answer what Status says, so that a page may choose its layout.
#define ZEP_SETTING(Name, Kind)                                                                     \
  long SetSys##Name(ZEP_SETPARAMS(Kind)) override {                                                 \
    ZEPHookDefaults::Ignore(ZEP_SETARGS(Kind));                                                     \
    ++_writes;                                                                                      \
    return S_OK;                                                                                    \
  }                                                                                                 \
  long GetSys##Name##Info(ZEPSettingInfo&) override { return Status(#Name); }

// The annotation layout (the larger one).
struct AnnotPage : ZEP2DBaseOptAnnotFrm {
  explicit AnnotPage(ZEPDialog* iParent) : ZEP2DBaseOptAnnotFrm(iParent, "AnnotationPage") {}
  long _writes = 0;
  static long Status(const char* iName) {
    return std::string(iName) == "CalloutSizeOverrun" ? 1 : S_OK;
  }
  ZEPString GetLegendTableLayoutContext() override { return "DrwLegend"; }
#include "ZEP2DBaseOptAnnotFrm.def"
};

// Every optional control and frame; both dialog buttons enabled.
struct DisplayPage : ZEP2DBaseOptDisplayFrm {
  explicit DisplayPage(ZEPDialog* iParent) : ZEP2DBaseOptDisplayFrm(iParent, "DisplayPage") {}
  long _writes = 0;
  static long Status(const char*) { return S_OK; }
  void Build() {
    int row = 0;
    ZEP2DBaseOptDisplayFrm::Build(row, 1);
  }
  long GetSysDimAnalysisDisplay(unsigned char& oValue) override { return oValue = 1, S_OK; }
  long GetSysVisuDiagnostic(unsigned char& oValue) override { return oValue = 1, S_OK; }
  unsigned char WithFrmVisualization() override { return 1; }
  unsigned char WithFrmGeometries() override { return 1; }
  unsigned char WithFrmCallouts() override { return 1; }
  unsigned char WithFrmWelding() override { return 1; }
  unsigned char WithFrmPatterns() override { return 1; }
  unsigned char WithFrmCapping() override { return 1; }
#include "ZEP2DBaseOptDisplayFrm.def"
};
#undef ZEP_SETTING

// The display page built and initialised, then both its dialogs opened.
void DisplayWithDialogsOpen(benchmark::State& state) {
  ZEPDlgWindow root(nullptr, "root", 0);
  for (auto _ : state) {
    auto* page = new DisplayPage(&root);
    page->Build();
    page->Initialize();
    ZEPDlgDriver::Click(ZEPDlgDriver::Find(page, "diagElementsColorsPushButton"));
    ZEPDlgDriver::Click(ZEPDlgDriver::Find(page, "diagGeometriesColorsPushButton"));
    if (!ZEPDlgDriver::Find(page, "cmbIsoConsElts")) state.SkipWithError("a dialog did not open");
    delete page;
  }
}

// A dialog of the newer framework opened and accepted.
void AnnotLegendDialogRoundTrip(benchmark::State& state) {
  ZEPDlgWindow root(nullptr, "root", 0);
  auto* page = new AnnotPage(&root);
  page->Build();
  page->Initialize();
  ZEPDialog* button = ZEPDlgDriver::Find(page, "pushLegendTableLayout");
  for (auto _ : state) {
    ZEPDlgDriver::Click(button);
    const std::vector<ZEPVidFraWindow*> open = ZEPVidFraWindow::Windows();
    if (open.empty() || !ZEPDlgDriver::Accept(ZEPSysDynamicCast<ZEPVidFraDialog>(open.back())))
      state.SkipWithError("the dialog did not open");
    ZEPDlgDriver::Idle();
  }
}
void AnnotClickTableResize(benchmark::State& state) {
  ClickToHook<AnnotPage>(state, "chkTableResize");
}
void DisplayClickDesignMode(benchmark::State& state) {
  ClickToHook<DisplayPage>(state, "checkDesignMode");
}
} // namespace

BENCHMARK_TEMPLATE(BuildAndInitialize, AnnotPage);
BENCHMARK_TEMPLATE(BuildAndInitialize, DisplayPage);
BENCHMARK(DisplayWithDialogsOpen);
BENCHMARK(AnnotLegendDialogRoundTrip);
BENCHMARK(AnnotClickTableResize);
BENCHMARK(DisplayClickDesignMode);
