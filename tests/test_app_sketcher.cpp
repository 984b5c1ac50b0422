// The application's sketcher settings: a grid page change reaches the sketcher once, already
// readable and in its range only; locks; several live instances; defaults shared with the table.
#include "TestSupport.h"
#include "ZEPAppPages.h"
#include "ZEPAppSketcher.h"

#include <map>
#include <memory>
#include <sstream>

using namespace zepapp;

namespace {
using Adapt = ZEP2DBaseSketcherSettingsAdapt;
using Values = std::map<std::string, std::vector<double>>; // stored name -> value (per range)
using Heard = std::vector<std::pair<std::string, Values>>; // event, what the adapter read then

// What the adapter reads of the attributes the grid page writes.
Values ReadAll(Adapt& iAdapt) {
  Values v{{Adapt::mstrGridDisplay, {double(iAdapt.GetGridVisuMode())}},
           {Adapt::mstrGridSnapPt, {double(iAdapt.GetGridSnapMode())}}};
  for (ZEPCkeScale r :
       {ZEPCkeScaleNormal, ZEPCkeScaleLarge, ZEPCkeScaleExtraLarge, ZEPCkeScaleSmall, ZEPCkeScaleExtraSmall}) {
    v[Adapt::mstrGridHPrSpacing].push_back(iAdapt.GetGridPrimSpac(r));
    v[Adapt::mstrGridHSecStep].push_back(iAdapt.GetGridSecStep(r));
    v[Adapt::mstrAllowDistortions].push_back(iAdapt.GetAllowDistortions(r));
    v[Adapt::mstrGridVPrSpacing].push_back(iAdapt.GetGridVPrimSpac(r));
    v[Adapt::mstrGridVSecStep].push_back(iAdapt.GetGridVSecStep(r));
  }
  // The diagnosis of sketch geometry, which the display page shows.
  v[Adapt::mstrDiagElts] = {double(iAdapt.GetDiagElts())};
  const std::pair<ZEP2DCstDiag, const char*> diags[] = {{ZEP2DCstOverDefined, Adapt::mstrColorDiagOverDefinedElts},
                                                        {ZEP2DCstNotConsistent, Adapt::mstrColorDiagNotConsistentElts},
                                                        {ZEP2DCstNotChanged, Adapt::mstrColorDiagNotChangedElts},
                                                        {ZEP2DCstWellDefined, Adapt::mstrColorDiagWellDefinedElts}};
  for (const auto& d : diags) {
    unsigned int r = 0, g = 0, b = 0;
    iAdapt.GetColorDiagElts(d.first, &r, &g, &b);
    v[d.second] = {double(r), double(g), double(b)};
  }
  return v;
}

class AppSketcher : public ZEPHostTest {
protected:
  void SetUp() override {
    ZEPHostTest::SetUp();
    ApplyDefaults();
    _pSketcher = std::make_unique<ZEPAppSketcherSettings>();
    Listen(*_pSketcher, _heard);
  }
  void TearDown() override {
    _pSketcher.reset();
    ZEPHostTest::TearDown();
  }
  void Listen(ZEPAppSketcherSettings& iSk, Heard& oHeard) {
    for (const char* event : {Adapt::GridModification(), Adapt::SnapModification(), Adapt::GeomUIModification(),
                              Adapt::CpltModification(), Adapt::MultiModification(), Adapt::Visu3DUIModification()})
      iSk.AddCallback(event, [&iSk, &oHeard](const char* iName, ZEPNotification*, void*) {
        oHeard.emplace_back(iName, ReadAll(iSk));
      });
  }
  void OpenGrid() { _pPage = FindPage("grid")->open(&_root); }
  ZEPDialog* Control(const char* iName) { return ZEPDlgDriver::FindControl(_pPage, iName); }
  bool SelectRange(int iRange) { return ZEPDlgDriver::Select(ZEPDlgDriver::Find(_pPage, "cmbGridRange"), iRange - 1); }

  std::unique_ptr<ZEPAppSketcherSettings> _pSketcher;
  Heard _heard;
  ZEPDlgFrame* _pPage = nullptr;
};
} // namespace

TEST_F(AppSketcher, EachGridPageChangeSendsOneEventWithTheNewValueInItsRangeOnly) {
  struct Change { // entered < 0: a click
    int range;
    const char* control;
    double entered;
    const char* (*event)();
    const char* stored;
    double expected;
  } const changes[] = {
      {2, "editorGridSpacing", 0.25, &Adapt::GridModification, Adapt::mstrGridHPrSpacing, 250.0},
      {3, "editorGridGraduation", 7, &Adapt::GridModification, Adapt::mstrGridHSecStep, 7},
      {4, "checkAllowDistortions", -1, &Adapt::GridModification, Adapt::mstrAllowDistortions, 1},
      {4, "editorGridSpacingV", 0.04, &Adapt::GridModification, Adapt::mstrGridVPrSpacing, 40.0},
      {4, "editorGridGraduationV", 3, &Adapt::GridModification, Adapt::mstrGridVSecStep, 3},
      {1, "checkGrid", -1, &Adapt::GridModification, Adapt::mstrGridDisplay, 0},
      {5, "checkSnap", -1, &Adapt::SnapModification, Adapt::mstrGridSnapPt, 0},
  };
  OpenGrid();
  for (const Change& c : changes) {
    SCOPED_TRACE(c.control);
    ASSERT_TRUE(SelectRange(c.range));
    Values expected = ReadAll(*_pSketcher);
    std::vector<double>& entries = expected[c.stored];
    entries[entries.size() == 5 ? c.range - 1 : 0] = c.expected;
    _heard.clear();
    ZEPDialog* control = Control(c.control);
    ASSERT_TRUE(c.entered < 0 ? ZEPDlgDriver::Click(control) : ZEPDlgDriver::Enter(control, c.entered));
    ASSERT_EQ(_heard.size(), 1u);
    EXPECT_EQ(_heard[0].first, c.event());
    EXPECT_EQ(_heard[0].second, expected); // already readable, other ranges as they were
  }
}

TEST_F(AppSketcher, LockedOrRefusedWritesNotifyNothing) {
  ZEPSysSettingRepository* specific = ZEPSysSettingRepository::GetRepository(kSketcherSpecificRepository);
  specific->SetLock(Adapt::mstrGridHSecStep, true, "admin");
  OpenGrid();
  const Values before = ReadAll(*_pSketcher);
  EXPECT_FALSE(Control("editorGridGraduation")->IsEffectivelyEnabled());
  EXPECT_FALSE(ZEPDlgDriver::Enter(Control("editorGridGraduation"), 4));
  // Locked once the page is open: the control takes the entry, the store refuses it.
  specific->SetLock(Adapt::mstrGridHPrSpacing, true, "admin");
  EXPECT_TRUE(ZEPDlgDriver::Enter(Control("editorGridSpacing"), 0.3));
  EXPECT_TRUE(_heard.empty());
  EXPECT_EQ(ReadAll(*_pSketcher), before);
}

TEST_F(AppSketcher, EveryLiveInstanceHearsPageChangesAndOtherRepositoriesAreIgnored) {
  ZEPAppSketcherSettings second;
  Heard secondHeard;
  Listen(second, secondHeard);
  FindPage("general")->open(&_root);
  ASSERT_TRUE(ZEPDlgDriver::Click(ZEPDlgDriver::FindControl(&_root, "checkViewFrame")));
  EXPECT_TRUE(_heard.empty() && secondHeard.empty());

  OpenGrid();
  ASSERT_TRUE(ZEPDlgDriver::Click(Control("checkSnap")));
  EXPECT_EQ(_heard.size(), 1u);
  EXPECT_EQ(secondHeard.size(), 1u);
  _pSketcher.reset(); // the first one goes, the second still hears
  ASSERT_TRUE(ZEPDlgDriver::Click(Control("checkGrid")));
  EXPECT_EQ(_heard.size(), 1u);
  EXPECT_EQ(secondHeard.size(), 2u);
}

TEST_F(AppSketcher, TableDefaultsAreTheAdapterReadDefaultsForEveryRange) {
  _pSketcher.reset();
  ZEPSysSettingRepository::CloseAll();
  ZEPAppSketcherSettings sketcher; // empty repositories: the adapter's own defaults
  const Values own = ReadAll(sketcher);
  for (ZEP2DCstDiag diag : {ZEP2DCstOverDefined, ZEP2DCstNotConsistent, ZEP2DCstNotChanged, ZEP2DCstWellDefined}) {
    unsigned int r = 0, g = 0, b = 0;
    sketcher.GetColorDiagElts(diag, &r, &g, &b);
    EXPECT_EQ((r << 16) | (g << 8) | b, sketcher.GetDefaultColorDiagElts(diag)) << diag;
  }
  Values table;
  for (const ZEPAppSetting& s : AppSettings())
    if (s.repository == kSketcherSpecificRepository) table[s.stored] = s.defaults;
  EXPECT_EQ(table, own); // also: the page writes nothing the sketcher does not read
}

TEST_F(AppSketcher, ListingShowsEachRangeOnItsOwnLine) {
  auto rangeLine = [this](const char* iStart) {
    std::ostringstream out;
    PrintSketcherSettings(*_pSketcher, out);
    std::istringstream in(out.str());
    for (std::string line; std::getline(in, line);)
      if (line.rfind(iStart, 0) == 0) return line;
    return std::string();
  };
  OpenGrid();
  ASSERT_TRUE(SelectRange(2));
  ASSERT_TRUE(ZEPDlgDriver::Enter(Control("editorGridSpacing"), 0.25));
  EXPECT_NE(rangeLine("  2 Large").find(" 250 "), std::string::npos);
  EXPECT_NE(rangeLine("  3 Extra large").find(" 1000000 "), std::string::npos);
}
