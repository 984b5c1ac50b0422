// Display page: sections on both sides of each layout predicate, optional controls on both sides
// of "exactly 0", the capping frame's padlocks, and the analysis display and
// diagnosis colour dialogs row by row.
#include "RecordingPages.h"

namespace {
// The analysed states, in dialog order.
const char* const kStates[] = {
    "AnnotDelGeom", "AnnotUnloadGeom", "AnnotInvalid", "DimNotUpToDate", "DimNonAssoc", "DimIsolated", "DimBroken",
    "DimFake", "DimDriving", "Dim3DCst", "TechFeatDim", "DimTrue", "DimOnNonVisGeom", "DimClipped",
    "FilterGeneratedElements", "CalloutLastUpdateFailed", "IsolatedCallout", "NotPerpendicularCallout",
    "DrwWeldNotUpToDate"};
const char* const kDiagColors[] = {"OverConsElts", "InconsElts", "NotChanElts", "IsoConsElts"};

class DisplayPage : public PageTest<RecordingDisplayPage> {
protected:
  ZEPDlgDialog* AnalysisDialog() { return OpenDialog("diagElementsColorsPushButton", "dlgAnalysisDisplay"); }
  ZEPDlgDialog* DiagDialog() { return OpenDialog("diagGeometriesColorsPushButton", "dlgVisuDiagColor"); }
};
} // namespace

TEST_F(DisplayPage, ModuleHooksBuildOnlyTheControlsThatNeedNoAnswer) {
  _script.options["FirstRow"] = 3;
  Open();
  EXPECT_EQ(_pPage->nextRow, 7);
  // Which controls are built, where and in which state, is in the dump.
  EXPECT_EQ(_script.reads.size(), 69u);
  EXPECT_TRUE(_script.calls.empty());
  ExpectGolden("display_page_module_hooks.dump", ZEPDlgDriver::Dump(_pPage));
}

TEST_F(DisplayPage, InfoZeroHostWithBothDialogsOpen) {
  _script.allInfoSet = true;
  _script.values = {
      {"DimAnalysisDisplay", {1}},           {"VisuDiagnostic", {1}},         {"DimDriving", {1}},
      {"DimDrivingColor", {255, 0, 0}},      {"AnnotInSpecTreePlane", {1}},   {"PatternContourPitch", {1}},
      {"PatternContourPitchThickness", {3}}, {"OverConsElts", {255, 0, 255}}, {"CappingColor", {0, 128, 0}},
      {"BackgroundInViewFrameMode", {2}}};
  Open();
  std::string dump = ZEPDlgDriver::Dump(_pPage);
  dump += ZEPDlgDriver::Dump(AnalysisDialog());
  dump += ZEPDlgDriver::Dump(DiagDialog());
  EXPECT_EQ(ZEPCheckLog::Count(), 0);
  ExpectGolden("display_page_info_zero.dump", dump);
}

TEST_F(DisplayPage, EachPredicateDecidesItsFrame) {
  _script.allInfoSet = true;
  _script.values = {{"DimAnalysisDisplay", {1}}};
  const struct {
    const char* predicate;
    const char* frame;
    bool inDialog;
  } cases[] = {{"WithFrmVisualization", "frameVisulization", false},
               {"WithFrmCapping", "frmCappingProperties", false},
               {"WithFrmGeometries", "frameGeometries", true},
               {"WithFrmCallouts", "frameCallouts", true},
               {"WithFrmWelding", "frameWelding", true},
               {"WithFrmPatterns", "framePatterns", true}};
  for (const auto& c : cases)
    for (long with : {0, 1}) {
      _script.options = {{c.predicate, with}};
      Open();
      if (c.inDialog) AnalysisDialog();
      EXPECT_EQ(Find(c.frame) != nullptr, with == 1) << c.predicate;
      EXPECT_EQ(_pPage->nextRow, c.inDialog || with ? 4 : 3) << c.predicate;
    }
  // Without the capping frame its values are still read.
  _script.options = {{"WithFrmCapping", 0}, {"WithFrmVisualization", 0}, {"WithFrmPatterns", 0}};
  _script.reads.clear();
  Open();
  EXPECT_EQ(_pPage->nextRow, 2);
  EXPECT_EQ(_script.reads.size(), 69u);
  EXPECT_EQ(Find("chkPatternContourPitch"), nullptr);
}

TEST_F(DisplayPage, OptionalControlsNeedExactlyZero) {
  const struct {
    const char* attribute;
    const char* control;
    const char* button; // the dialog it is in; null on the page
  } cases[] = {{"TrackHistory", "checkTrackHistory", nullptr},
               {"Ditto", "checkDitto", nullptr},
               {"AnnotInSpecTreeAnnotSet", "checkAnnotInSpecTreeAnnotSet", nullptr},
               {"VisuDiagnostic", "diagGeometriesColorsPushButton", nullptr},
               {"DimClipped", "chkDimClipped", "diagElementsColorsPushButton"},
               {"IsoConsElts", "cmbIsoConsElts", "diagGeometriesColorsPushButton"}};
  for (const auto& c : cases)
    for (long status : {0L, 1L, E_NOTIMPL}) {
      _script.info = {{c.attribute, status}, {"VisuDiagnostic", 0}};
      _script.values = {{"DimAnalysisDisplay", {1}}, {"VisuDiagnostic", {1}}};
      Open();
      if (c.button && Control(c.button)) Click(c.button);
      EXPECT_EQ(Find(c.control) != nullptr, status == 0) << c.control << " " << status;
    }
  // Without the flag of the caller the track history check is never built.
  _script.info = {{"TrackHistory", 0}};
  _script.options = {{"WithTrackHistory", 0}};
  Open();
  EXPECT_EQ(Find("checkTrackHistory"), nullptr);
  EXPECT_EQ(Row("labelDisplay"), 0);
}

TEST_F(DisplayPage, TreeRowsStayCompact) {
  _script.info = {{"Relations", 0}, {"HideIn3DStatus", 0}, {"Ditto", 0}};
  Open();
  EXPECT_EQ(Row("checkRelations"), Row("invLock"));
  const ZEPDialog::Cell& hide = Find("checkHideIn3DStatus")->GetGridConstraints();
  EXPECT_EQ(hide.row, Row("checkRelations"));
  EXPECT_EQ(hide.column, 3);
  EXPECT_EQ(Row("checkDitto"), hide.row + 1);
  // Nothing before it: the row of "labelDisplay".
  _script.info = {{"HideIn3DStatus", 0}};
  Open();
  EXPECT_EQ(Row("checkHideIn3DStatus"), Row("labelDisplay"));
}

TEST_F(DisplayPage, PageChecksAndTheirDependants) {
  _script.allInfoSet = true;
  _script.values = {{"AnnotInSpecTreePlane", {1}}, {"AnnotInSpecTreeAnnotSet", {1}}};
  Open();
  const struct {
    const char* check;
    const char* dependant;
  } cases[] = {{"checkAnnotInSpecTreePlane", "checkAnnotInSpecTreeAnnotSet"},
               {"checkDesignMode", "diagElementsColorsPushButton"},
               {"checkVisualizationDiag", "diagGeometriesColorsPushButton"},
               {"chkBackgroundInViewFrame", "radBackgroundInViewFrameDemand"}};
  for (const auto& c : cases) {
    const bool on = Checked(c.check);
    EXPECT_EQ(Enabled(c.dependant), on) << c.dependant;
    ASSERT_TRUE(Click(c.check));
    EXPECT_EQ(Enabled(c.dependant), !on) << c.dependant;
  }
  EXPECT_TRUE(Checked("checkAnnotInSpecTreeAnnotSet")) << "disabled, its value kept";
  EXPECT_EQ(Hooks(), (std::vector<std::string>{"SetSysAnnotInSpecTreePlane", "SetSysDimAnalysisDisplay",
                                               "SetSysVisuDiagnostic", "SetSysBackgroundInViewFrame"}));
}

TEST_F(DisplayPage, CappingColourFollowsTheBackgroundRadiosAndBothPadlocks) {
  _script.allInfoSet = true;
  _script.values = {{"CappingBackground", {2}}};
  Open();
  // A stored 2 shows the fixed colour radio, its combo disabled.
  EXPECT_TRUE(Checked("radCappingColorFix"));
  EXPECT_FALSE(Enabled("cmbCappingColor"));
  ASSERT_TRUE(Click("radCappingColorFromFace"));
  ASSERT_TRUE(Click("radCappingColorFix"));
  EXPECT_TRUE(Enabled("cmbCappingColor"));
  EXPECT_TRUE(Enabled("chkCappingColorScale"));
  ASSERT_TRUE(ZEPDlgDriver::SelectColor(Control("cmbCappingColor"), 10, 20, 30));
  ASSERT_EQ(Hooks(),
            (std::vector<std::string>{"SetSysCappingBackground", "SetSysCappingBackground", "SetSysCappingColor"}));
  EXPECT_EQ(_script.calls[2].values, (std::vector<double>{10, 20, 30}));
  // Locking the background locks the colour and its scale, which sit inside its frame.
  for (const char* lock : {"CappingBackground", "CappingColor"}) {
    _script.locked = {lock};
    _script.values = {{"CappingBackground", {0}}};
    Open();
    EXPECT_FALSE(Enabled("cmbCappingColor")) << lock;
    EXPECT_EQ(Enabled("chkCappingColorScale"), std::string(lock) == "CappingColor") << lock;
  }
}

TEST_F(DisplayPage, EveryAnalysedStateWritesThroughItsOwnHooks) {
  _script.allInfoSet = true;
  _script.values = {{"DimAnalysisDisplay", {1}}};
  Open();
  ZEPDlgDialog* dialog = AnalysisDialog();
  ASSERT_NE(dialog, nullptr);
  for (const char* state : kStates) {
    const std::string name = state;
    _script.calls.clear();
    ZEPDialog* combo = Control("cmb" + name, dialog);
    EXPECT_FALSE(combo->IsEffectivelyEnabled()) << name << ": state off, colour disabled";
    ASSERT_TRUE(Click("chk" + name, dialog));
    EXPECT_TRUE(combo->IsEffectivelyEnabled()) << name;
    ASSERT_TRUE(ZEPDlgDriver::SelectColor(combo, 1, 2, 3));
    ASSERT_EQ(Hooks(), (std::vector<std::string>{"SetSys" + name, "SetSys" + name + "Color"}));
    EXPECT_EQ(_script.calls[0].values[0], 1.0);
    EXPECT_EQ(_script.calls[1].values, (std::vector<double>{1, 2, 3}));
  }
  // Reopened, the dialog shows what was written.
  ASSERT_TRUE(ZEPDlgDriver::CloseDialog(dialog));
  ZEPDlgDriver::Idle();
  dialog = AnalysisDialog();
  EXPECT_TRUE(Checked("chkDimTrue", dialog));
}

TEST_F(DisplayPage, StateRowsAreCompactInTheirFrame) {
  _script.info = {{"DimDriving", 0}, {"DimTrue", 0}};
  _script.values = {{"DimAnalysisDisplay", {1}}};
  Open();
  ZEPDlgDialog* dialog = AnalysisDialog();
  EXPECT_EQ(Row("chkDimDriving", dialog), 0);
  EXPECT_EQ(Row("cmbDimTrue", dialog), 1);
  EXPECT_EQ(Find("chkDimFake", dialog), nullptr);
  // The pattern controls need no answer.
  EXPECT_NE(Find("chkPatternContourPitch", dialog), nullptr);
}

TEST_F(DisplayPage, PatternPitchWeightAndDiagnosisColours) {
  _script.allInfoSet = true;
  _script.values = {{"DimAnalysisDisplay", {1}},
                    {"VisuDiagnostic", {1}},
                    {"PatternContourPitchThickness", {3}},
                    {"OverConsElts", {200, 100, 50}},
                    {"InconsElts", {4294967295.0, 0, 0}}};
  Open();
  ZEPDlgDialog* analysis = AnalysisDialog();
  auto* weight = Control("cmbPatternContourPitch", analysis);
  EXPECT_EQ(ZEPSysDynamicCast<ZEPComboWeight>(weight)->GetSelect(), 3u);
  EXPECT_FALSE(weight->IsEffectivelyEnabled());
  ASSERT_TRUE(Click("chkPatternContourPitch", analysis));
  ASSERT_TRUE(ZEPDlgDriver::Select(weight, 4));
  ZEPDlgDialog* diag = DiagDialog();
  unsigned int rgb[3] = {0, 0, 0};
  ZEPSysDynamicCast<ZEPComboColor>(Control("cmbOverConsElts", diag))->GetSelectedColor(&rgb[0], &rgb[1], &rgb[2]);
  EXPECT_EQ(std::vector<unsigned int>(rgb, rgb + 3), (std::vector<unsigned int>{200, 100, 50}));
  // A colour out of range is not shown: no conversion wraps it into one.
  ZEPSysDynamicCast<ZEPComboColor>(Control("cmbInconsElts", diag))->GetSelectedColor(&rgb[0], &rgb[1], &rgb[2]);
  EXPECT_NE(std::vector<unsigned int>(rgb, rgb + 3), (std::vector<unsigned int>{255, 0, 0}));
  for (const char* name : kDiagColors)
    ASSERT_TRUE(ZEPDlgDriver::SelectColor(Control(std::string("cmb") + name, diag), 255, 128, 0));
  ASSERT_EQ(_script.calls.size(), 6u);
  EXPECT_EQ(_script.calls[1].hook, "SetSysPatternContourPitchThickness");
  EXPECT_EQ(_script.calls[1].values[0], 5.0);
  for (int i = 0; i < 4; ++i) {
    EXPECT_EQ(_script.calls[2 + i].hook, std::string("SetSys") + kDiagColors[i]);
    EXPECT_EQ(_script.calls[2 + i].values, (std::vector<double>{255, 128, 0}));
  }
}

TEST_F(DisplayPage, DialogsOpenOnceAndLocksHoldInside) {
  _script.allInfoSet = true;
  _script.locked = {"DimFake", "IsoConsElts", "PatternContourPitch"};
  _script.values = {{"DimAnalysisDisplay", {1}}, {"VisuDiagnostic", {1}}, {"DimFake", {1}}};
  Open();
  ZEPDlgDialog* analysis = AnalysisDialog();
  analysis->SetVisibility(ZEPDlgHide);
  EXPECT_EQ(AnalysisDialog(), analysis) << "a second press shows the open dialog";
  EXPECT_EQ(analysis->GetVisibility(), ZEPDlgShow);
  int dialogs = 0;
  for (ZEPDialog* child : _pPage->GetChildren()) dialogs += ZEPSysDynamicCast<ZEPDlgDialog>(child) ? 1 : 0;
  EXPECT_EQ(dialogs, 1);
  // A locked state stays off-limits though ticked; its colour, not locked, follows the state.
  EXPECT_FALSE(Click("chkDimFake", analysis));
  EXPECT_TRUE(Enabled("cmbDimFake", analysis));
  EXPECT_FALSE(Click("chkPatternContourPitch", analysis));
  ZEPDlgDialog* diag = DiagDialog();
  EXPECT_FALSE(ZEPDlgDriver::SelectColor(Control("cmbIsoConsElts", diag), 1, 1, 1));
  EXPECT_TRUE(ZEPDlgDriver::SelectColor(Control("cmbNotChanElts", diag), 1, 1, 1));
  // Disabling the button leaves the open dialog open.
  ASSERT_TRUE(Click("checkDesignMode"));
  EXPECT_TRUE(analysis->IsEffectivelyEnabled());
  EXPECT_EQ(Hooks(), (std::vector<std::string>{"SetSysNotChanElts", "SetSysDimAnalysisDisplay"}));
  // Closing one dialog leaves the other.
  ASSERT_TRUE(ZEPDlgDriver::Close(diag));
  ZEPDlgDriver::Idle();
  EXPECT_EQ(Find("dlgVisuDiagColor"), nullptr);
  EXPECT_EQ(Find("dlgAnalysisDisplay"), analysis);
}
