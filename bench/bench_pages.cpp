// Page costs: building and initialising each page, and one user change reaching its hook.
#include "ZEP2DBaseOptDimFrm.h"
#include "ZEP2DBaseOptAdminFrm.h"
#include "ZEP2DBaseOptAnnotFrm.h"
#include "ZEP2DBaseOptDisplayFrm.h"
#include "ZEP2DBaseOptGalFrm.h"
#include "ZEP2DBaseOptGeoFrm.h"
#include "ZEP2DBaseOptGridFrm.h"
#include "ZEP2DBaseOptManipFrm.h"
#include "ZEP2DBaseOptMainFrm.h"
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
struct ManipPage : ZEP2DBaseOptManipFrm {
  explicit ManipPage(ZEPDialog* iParent) : ZEP2DBaseOptManipFrm(iParent, "ManipulatorsPage") {}
  void Build() { ZEP2DBaseOptManipFrm::Build(1); }
  long _writes = 0;
#include "ZEP2DBaseOptManipFrm.def"
};
struct AdminPage : ZEP2DBaseOptAdminFrm {
  explicit AdminPage(ZEPDialog* iParent) : ZEP2DBaseOptAdminFrm(iParent, "AdministrationPage") {}
  void Build() { ZEP2DBaseOptAdminFrm::Build(0); }
  long _writes = 0;
  ZEPString GetFrameIconName() override { return "I_AdminDrawing"; }
  unsigned char WithFrmGVS() override { return 1; }
  unsigned char WithFrmAssemblyMgmt() override { return 1; }
  unsigned char WithFrmTitleBlock() override { return 1; }
  ZEPSysPreferenceRepository* GetDlgPreferenceRepository() override { return nullptr; }
#include "ZEP2DBaseOptAdminFrm.def"
};
struct MainPage : ZEP2DBaseOptMainFrm {
  explicit MainPage(ZEPDialog* iParent) : ZEP2DBaseOptMainFrm(iParent, "MainPage") {}
  long _writes = 0;
  ZEPString GetFrameIconName() override { return "I_MainOptions"; }
  ZEPUnicodeString GetDefaultStandardName() override { return "ISO"; }
#include "ZEP2DBaseOptMainFrm.def"
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
BENCHMARK_TEMPLATE(BuildAndInitialize, MainPage);

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

BENCHMARK_TEMPLATE(BuildAndInitialize, ManipPage);
BENCHMARK_TEMPLATE(BuildAndInitialize, AdminPage);

// Every page of this module built and initialised, one after the other, as the options dialog
// opens them.
template <class Page> ZEPDlgFrame* Opened(ZEPDialog* iParent) {
  auto* page = new Page(iParent);
  page->Build();
  page->Initialize();
  return page;
}
void AllPagesBuildAndInitialize(benchmark::State& state) {
  ZEPDlgWindow root(nullptr, "root", 0);
  for (auto _ : state) {
    ZEPDlgFrame* pages[] = {Opened<GridPage>(&root),  Opened<GalPage>(&root),
                            Opened<PrimaryViewPage>(&root), Opened<GeoPage>(&root),
                            Opened<ManipPage>(&root), Opened<AdminPage>(&root)};
    benchmark::DoNotOptimize(pages);
    for (ZEPDlgFrame* page : pages)
      delete page;
  }
}
BENCHMARK(AllPagesBuildAndInitialize);

void ManipClickMatrixCell(benchmark::State& state) { ClickToHook<ManipPage>(state, "_checkDimChangeSymbolMod"); }
BENCHMARK(ManipClickMatrixCell);
// The standard combo as the user goes through it: open the list, pick a standard, close it.
void MainChooseStandard(benchmark::State& state) {
  ZEPDlgWindow root(nullptr, "root", 0);
  auto* page = new MainPage(&root);
  page->Build();
  page->Initialize();
  ZEPDialog* combo = ZEPDlgDriver::FindControl(page, "cmbStandardName");
  int line = 0;
  for (auto _ : state) {
    ZEPDlgDriver::DropDown(combo);
    ZEPDlgDriver::Select(combo, line);
    ZEPDlgDriver::CloseUp(combo);
    line = 1 - line;
  }
  if (page->_writes == 0) state.SkipWithError("no standard was written");
}
BENCHMARK(MainChooseStandard);
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
