// Geometry page: the embedded grid page, sensitivity rules, colours, the reference size and the
// three sub-dialogs, operated through the driver as the user does.
#include "RecordingPages.h"

namespace {
using GeoPage = PageTest<RecordingGeoPage>;

const char* const kDialogs[][2] = {{"dragOptionPushButton", "geoAllowGeomManip"},
                                   {"smartPickPushButton", "geoSmartPick"},
                                   {"cstTypesPushButton", "geoTypeCst"}};
} // namespace

TEST_F(GeoPage, ModuleHooksShowZerosAndDisableTheDependants) {
  Open(); // the zeros, the disabled dependants and the grid page on top are in the dump
  // The grid page was initialised before the page's own values.
  ASSERT_FALSE(_script.reads.empty());
  EXPECT_EQ(_script.reads.front(), "DisplayGrid");
  EXPECT_EQ(_script.reads.back(), "DittoPreventScale");
  EXPECT_EQ(ZEPCheckLog::Count(), 0);
  ExpectGolden("geo_page_module_hooks.dump", ZEPDlgDriver::Dump(_pPage));
  // The dialogs with the module's hooks, their buttons enabled by the two flags alone.
  _script.values = {{"AllowGeomManip", {1}}, {"DisplayCst", {1}}};
  Open();
  std::string dialogs;
  for (const auto& d : kDialogs) dialogs += ZEPDlgDriver::Dump(OpenDialog(d[0], d[1]));
  ExpectGolden("geo_dialogs_module_hooks.dump", dialogs);
}

TEST_F(GeoPage, EmbeddedGridPageWritesThroughTheSameHostAndTheRowsStayWithoutIt) {
  Open();
  ASSERT_TRUE(Click("checkGrid"));
  ASSERT_TRUE(Click("DittoDrag"));
  EXPECT_EQ(Hooks(), (std::vector<std::string>{"SetSysDisplayGrid", "SetSysDittoPreventManip"}));
  _script.calls.clear();
  _script.options["CreateGridFrame"] = 0;
  Open();
  EXPECT_EQ(Find("GridPage"), nullptr);
  EXPECT_EQ(Row("frameCenter"), 1);
  EXPECT_EQ(Row("frameDittoInv"), 4);
  ASSERT_TRUE(Click("checkCenter"));
  EXPECT_EQ(Hooks(), std::vector<std::string>{"SetSysCreateGeomCenter"});
}

TEST_F(GeoPage, AllInfoHooksAnsweringZeroAndEveryDialog) {
  _script.allInfoSet = true;
  _script.values = {{"AllowGeomManip", {1}},   {"DisplayCst", {1}},          {"RefSizeCst", {2.5}},
                    {"ColorCst", {255, 0, 0}}, {"SmartPick", {67, 102, 85}}, {"DragSolveMode", {1}},
                    {"CstVisuPara", {1}},      {"SmartPickAlign", {1}}};
  Open();
  std::string dump = ZEPDlgDriver::Dump(_pPage);
  for (const auto& d : kDialogs) dump += ZEPDlgDriver::Dump(OpenDialog(d[0], d[1]));
  ExpectGolden("geo_page_info_zero.dump", dump);
}

TEST_F(GeoPage, DependantsFollowTheirCheckButtonsButLocksWin) {
  _script.allInfoSet = true;
  _script.locked = {"RefSizeCst"};
  Open();
  ASSERT_TRUE(Click("checkGeomDrag"));
  EXPECT_TRUE(Enabled("dragOptionPushButton"));
  ASSERT_TRUE(Click("checkCstVisu"));
  EXPECT_TRUE(Enabled("comboCstColor"));
  EXPECT_TRUE(Enabled("cstTypesPushButton"));
  EXPECT_FALSE(Enabled("editorCstRefSize")); // locked
  ASSERT_TRUE(Click("checkCstVisu"));
  EXPECT_FALSE(Enabled("comboCstColor"));
  ASSERT_TRUE(Click("checkGeomDrag"));
  EXPECT_FALSE(Enabled("dragOptionPushButton"));
  ASSERT_EQ(_script.calls.size(), 4u);
  EXPECT_EQ(_script.calls[3].hook, "SetSysAllowGeomManip");
  EXPECT_EQ(_script.calls[3].values[0], 0.0);
}

TEST_F(GeoPage, ColoursAreReadThroughTheColourCombos) {
  _script.values = {{"DisplayCst", {1}}, {"SmartPick", {67, 102, 85}}};
  Open();
  ASSERT_TRUE(ZEPDlgDriver::SelectColor(Control("cmbSmartPick"), 10, 20, 30));
  ASSERT_TRUE(ZEPDlgDriver::SelectColor(Control("comboCstColor"), 200, 0, 7));
  ASSERT_TRUE(ZEPDlgDriver::Select(Control("comboCstColor"), 2)); // a named line: red
  ASSERT_EQ(Hooks(), (std::vector<std::string>{"SetSysSmartPick", "SetSysColorCst", "SetSysColorCst"}));
  EXPECT_EQ(_script.calls[0].values, (std::vector<double>{10, 20, 30}));
  EXPECT_EQ(_script.calls[1].values, (std::vector<double>{200, 0, 7}));
  EXPECT_EQ(_script.calls[2].values, (std::vector<double>{255, 0, 0}));
  EXPECT_EQ(ZEPCheckLog::Count(), 0);
}

TEST_F(GeoPage, ReferenceSizeIsAPaperLengthInMillimetresAtTheHooks) {
  int inch = 5;
  _pOptions->WriteAttr("DrwPaperLengthUnit", &inch, 1);
  _script.values = {{"DisplayCst", {1}}, {"RefSizeCst", {2.5}}};
  Open();
  auto* spinner = Spinner("editorCstRefSize");
  EXPECT_DOUBLE_EQ(spinner->GetValue(), 0.0025);
  EXPECT_EQ(spinner->UnitSymbol(), "in");
  ASSERT_TRUE(ZEPDlgDriver::Enter(spinner, 0.004));
  ASSERT_TRUE(ZEPDlgDriver::Enter(spinner, -1.0)); // clamped at the lower limit
  ASSERT_EQ(_script.Calls("SetSysRefSizeCst").size(), 2u);
  EXPECT_DOUBLE_EQ(_script.calls[0].values[0], 4.0);
  EXPECT_DOUBLE_EQ(_script.calls[1].values[0], 0.0);
}

// Stored 7 shows the standard radio; a notification with that radio still on writes 0. (What
// each stored value shows and each click writes is a test of every radio group.)
TEST_F(GeoPage, DragModeRadioNotifiedWhileOnWritesWhatItShows) {
  _script.values = {{"AllowGeomManip", {1}}, {"DragSolveMode", {7}}};
  Open();
  OpenDialog("dragOptionPushButton", "geoAllowGeomManip");
  ASSERT_TRUE(Checked("radioDragModeStd"));
  Radio("radioDragModeStd")->SendNotification(Radio("radioDragModeStd")->GetRadBModifyNotification());
  EXPECT_EQ(Written("SetSysDragSolveMode"), std::vector<double>{0});
}

TEST_F(GeoPage, EverySubDialogOpensOnceWritesAndForgetsItsControlsWhenClosed) {
  _script.values = {{"AllowGeomManip", {1}}, {"DisplayCst", {1}}, {"SmartPickHoriVerti", {1}}, {"CstVisuSym", {1}}};
  Open();
  EXPECT_EQ(As<ZEPDlgCheckButton>("checkSmartPickHoriVerti"), nullptr); // not before the push
  const char* const inside[] = {"checkDragWithEndPts", "checkSmartPickHoriVerti", "checkCstVisuSym"};
  const char* const hooks[] = {"SetSysDragWithEndPts", "SetSysSmartPickHoriVerti", "SetSysCstVisuSym"};
  for (int i = 0; i < 3; ++i) {
    for (bool windowClose : {false, true}) {
      _script.calls.clear();
      ZEPDlgDialog* dialog = OpenDialog(kDialogs[i][0], kDialogs[i][1]);
      ASSERT_NE(dialog, nullptr) << kDialogs[i][1];
      EXPECT_EQ(dialog->GetVisibility(), ZEPDlgShow);
      // A second press shows the open dialog and creates nothing.
      dialog->SetVisibility(ZEPDlgHide);
      ASSERT_TRUE(Click(kDialogs[i][0]));
      EXPECT_EQ(Children(kDialogs[i][1]).size(), 1u);
      EXPECT_EQ(dialog->GetVisibility(), ZEPDlgShow);
      auto* check = As<ZEPDlgCheckButton>(inside[i], dialog);
      const bool wasOn = check->GetState() == ZEPDlgChecked;
      EXPECT_EQ(wasOn, windowClose != (i != 0)) << "shows the cached value: stored, then as last written";
      ASSERT_TRUE(ZEPDlgDriver::Click(check));
      ASSERT_EQ(Hooks(), std::vector<std::string>{hooks[i]});
      EXPECT_EQ(_script.calls[0].values[0], wasOn ? 0.0 : 1.0);
      ASSERT_TRUE(windowClose ? ZEPDlgDriver::Close(dialog) : ZEPDlgDriver::CloseDialog(dialog));
      // Closed but not yet destroyed: its controls no longer reach the hooks.
      ASSERT_TRUE(ZEPDlgDriver::Click(check));
      EXPECT_EQ(_script.calls.size(), 1u);
      ZEPDlgDriver::Idle();
      EXPECT_EQ(Children(kDialogs[i][1]).size(), 0u);
    }
  }
  // A fresh dialog shows the value written from the previous one.
  ZEPDlgDialog* dialog = OpenDialog("cstTypesPushButton", "geoTypeCst");
  EXPECT_TRUE(Checked("checkCstVisuSym", dialog));
  EXPECT_EQ(ZEPCheckLog::Count(), 0);
}

TEST_F(GeoPage, LockedSettingsInsideADialogStayLocked) {
  _script.allInfoSet = true;
  _script.locked = {"DragSolveMode", "CstVisuPerpen"};
  _script.values = {{"AllowGeomManip", {1}}, {"DisplayCst", {1}}};
  Open();
  ZEPDlgDialog* drag = OpenDialog("dragOptionPushButton", "geoAllowGeomManip");
  ASSERT_NE(Find("frameDragMode", drag), nullptr);
  EXPECT_FALSE(Click("radioDragModeRel"));
  EXPECT_TRUE(Click("checkDragWithEndPts"));
  ZEPDlgDialog* types = OpenDialog("cstTypesPushButton", "geoTypeCst");
  EXPECT_FALSE(Click("checkCstVisuPerpen", types));
  EXPECT_TRUE(Click("checkCstVisuPara", types));
  EXPECT_EQ(Hooks(), (std::vector<std::string>{"SetSysDragWithEndPts", "SetSysCstVisuPara"}));
}
