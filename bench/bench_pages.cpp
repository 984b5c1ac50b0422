// Page costs: building and initialising each page, and one user change reaching its hook.
#include "ZEP2DBaseOptDimFrm.h"
#include "ZEP2DBaseOptGalFrm.h"
#include "ZEP2DBaseOptGeoFrm.h"
#include "ZEP2DBaseOptGridFrm.h"
#include "ZEP2DBasePrimaryViewFrm.h"

#include <benchmark/benchmark.h>

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
struct DimPage : ZEP2DBaseOptDimFrm {
  explicit DimPage(ZEPDialog* iParent) : ZEP2DBaseOptDimFrm(iParent, "DimensionPage") {}
  long _writes = 0;
#include "ZEP2DBaseOptDimFrm.def"
};
struct GeoPage : ZEP2DBaseOptGeoFrm {
  explicit GeoPage(ZEPDialog* iParent) : ZEP2DBaseOptGeoFrm(iParent, "GeometryPage") {}
  long _writes = 0;
  ZEP2DBaseOptGridFrm* CreateGridFrame() override { return new GridPage(this); }
#include "ZEP2DBaseOptGeoFrm.def"
};
#undef ZEP_SETTING

// The drafting options the host keeps open: pages read the paper length unit there.
void OpenDraftingOptions() { ZEPSysSettingRepository::Open("DraftingOptions"); }

template <class Page> void BuildAndInitialize(benchmark::State& state) {
  OpenDraftingOptions();
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
BENCHMARK_TEMPLATE(BuildAndInitialize, DimPage);

// A sub-dialog as the user goes through it: press its button, tick a check, close it.
void GeoSubDialogRoundTrip(benchmark::State& state) {
  OpenDraftingOptions();
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

// The application's pages, bound to the settings store: each page built and initialised by
// itself, and all of them together as the dialog opens them.
#include "ZEPAppPages.h"

namespace {
void OpenAppRepositories() {
  for (const std::string& name : zepapp::AppRepositories()) ZEPSysSettingRepository::Open(name);
  zepapp::ApplyDefaults();
}

void AppPage(benchmark::State& state, std::size_t iPage) {
  OpenAppRepositories();
  const zepapp::ZEPAppPage& page = zepapp::AppPages().at(iPage);
  state.SetLabel(page.name);
  ZEPDlgWindow root(nullptr, "root", 0);
  for (auto _ : state) delete page.open(&root);
}

void AppPagesAll(benchmark::State& state) {
  OpenAppRepositories();
  ZEPDlgWindow root(nullptr, "root", 0);
  for (auto _ : state) {
    std::vector<ZEPDlgFrame*> pages;
    for (const zepapp::ZEPAppPage& page : zepapp::AppPages()) pages.push_back(page.open(&root));
    for (ZEPDlgFrame* page : pages) delete page;
  }
}

const int kAppPagesRegistered = [] {
  for (std::size_t i = 0; i < zepapp::AppPages().size(); ++i)
    benchmark::RegisterBenchmark("AppPage", AppPage, i)->Unit(benchmark::kMicrosecond);
  benchmark::RegisterBenchmark("AppPages/All", AppPagesAll)->Unit(benchmark::kMicrosecond);
  return 0;
}();
} // namespace
