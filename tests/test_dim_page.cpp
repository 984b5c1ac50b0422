// Dimension page: optional controls and layout options, radios read again, the follow
// cursor and cumulated value rules, paper lengths and angles, the 3D associativity dialog and the
// page's registration with the object model.
#include "RecordingPages.h"

#include "ZEPDrwLockCheckButton.h"
#include "ZEPDrwLockSpinner.h"

#include <cmath>

namespace {
class DimPage : public PageTest<RecordingDimPage> {
protected:
  // In normal use the page reports no failed check.
  void TearDown() override {
    for (const ZEPCheckEntry& e : ZEPCheckLog::Entries()) ADD_FAILURE() << "check: " << e.expression;
    PageTest::TearDown();
  }
  // The 3D associativity dialogs, among the page's own children (a section of the page has the
  // same name as the dialog's first section).
  std::vector<ZEPDialog*> Dialogs() { return Children("dimAssocWnd"); }
  ZEPDlgDialog* PushAssoc3D() {
    EXPECT_TRUE(Click("pushAssoc3D"));
    std::vector<ZEPDialog*> dialogs = Dialogs();
    return dialogs.empty() ? nullptr : ZEPSysDynamicCast<ZEPDlgDialog>(dialogs.back());
  }
};

const double kPi = std::acos(-1.0);
const std::vector<const char*> kCircle = {"_radioDimCircleCenter", "_radioDimCircleEdge"};
const std::vector<const char*> kForce2D = {"_radioDimForce2DAlways", "_radioDimForce2DWhenPb", "_radioDimForce2DNever"};
} // namespace

TEST_F(DimPage, ModuleHooksAndAllInfoHooksAnsweringZero) {
  // The controls, their rows and states are in the dump.
  Open();
  // The approximate flag is read after the line-up values.
  EXPECT_EQ(_script.reads, (std::vector<std::string>{"DimFollowMouse", "DimConstantOffset", "DimConstantOffsetValue",
                                                     "DimAssoc3DMod", "DimCreateDrive", "DimDetectChamfer",
                                                     "DimCreateCircle", "DimActivateSnapBetSymbols", "DimMoveSubPart",
                                                     "DimOffsetRefMM", "DimOffsetRefDeg", "DimOffsetBetMM",
                                                     "DimOffsetBetDeg", "DimAlignStackValue", "DimAlignCumulValue",
                                                     "DimCumulAddFunnel", "AssocDimOnApproximate", "DimOriginSymb"}));
  EXPECT_TRUE(_script.calls.empty());
  ExpectGolden("dim_page_module_hooks.dump", ZEPDlgDriver::Dump(_pPage));
  _script = HookScript();
  _script.allInfoSet = true;
  _script.options = {{"WithFrmCreateDriveAndChamfer", 1}, {"WithLineUpValues", 1}, {"WithFrmDimOrigin", 1}};
  _script.values = {{"DimConstantOffsetValue", {12.5}}, {"DimAssoc3DMod", {1}},    {"AssocDimOnApproximate", {1}},
                    {"DimCreateCircle", {1}},           {"DimOffsetRefDeg", {90}}, {"DimAlignCumulValue", {1}},
                    {"DimCumulAddFunnel", {1}},         {"DimOriginSymb", {1}},    {"DimOffsetBetMM", {-4}}};
  Open();
  ExpectGolden("dim_page_info_zero.dump", ZEPDlgDriver::Dump(_pPage));
  ZEPDlgDialog* dialog = PushAssoc3D();
  ASSERT_NE(dialog, nullptr);
  ExpectGolden("dim_page_assoc_dialog.dump", ZEPDlgDriver::Dump(dialog));
}

// The 3D associativity button needs a status that is not negative, the funnel exactly 0.
TEST_F(DimPage, OptionalControlsFollowTheirInfoStatus) {
  for (long status : {-1L, 0L, 1L}) {
    _script.info["DimAssoc3DMod"] = status;
    _script.info["DimCumulAddFunnel"] = status;
    Open();
    EXPECT_EQ(Find("pushAssoc3D") != nullptr, status >= 0) << status;
    EXPECT_EQ(Find("checkLineUpAutoFunnel") != nullptr, status == 0) << status;
    EXPECT_EQ(Find("tmpFrame") != nullptr, status == 0) << status;
    // Absent controls leave the other rows where they are.
    EXPECT_EQ(Row("frm"), 4) << status;
    EXPECT_EQ(Row("_frameDimCircle"), 5) << status;
    if (status >= 0) {
      EXPECT_EQ(Row("frameDimAssoc3D"), 3);
      EXPECT_EQ(Find("pushAssoc3D")->GetParentDialog(), Find("frameDimAssoc3D"));
    }
  }
  // A host with the setting but a failed funnel info still writes every other line-up value.
  ASSERT_TRUE(Click("checkLineUpCumulVal"));
  EXPECT_EQ(Written("SetSysDimAlignCumulValue"), std::vector<double>{1});
}

TEST_F(DimPage, LayoutOptions) {
  _script.options = {{"WithFrmCreateDriveAndChamfer", 0}, {"WithLineUpValues", 0}, {"WithFrmDimOrigin", 0}};
  Open();
  for (const char* name : {"frm", "checkDimDriveAuto", "chkDetectChamfer", "_labelLineUpBaseOffset",
                           "_labelLineUpOffset", "_editorLineUpBaseOffsetLength", "_editorLineUpBaseOffsetAngle",
                           "_editorLineUpOffsetLength", "_editorLineUpOffsetAngle", "frmDimOriented"})
    EXPECT_EQ(Find(name), nullptr) << name;
  EXPECT_EQ(Row("checkLineUpStackVal"), 2);
  EXPECT_EQ(Row("checkLineUpCumulVal"), 3);
  EXPECT_EQ(Row("_frameDimCircle"), 5);

  _script.options = {{"WithFrmCreateDriveAndChamfer", 1}, {"WithLineUpValues", 1}, {"WithFrmDimOrigin", 1}};
  _script.values["DimOriginSymb"] = {1};
  Open(); // the controls it builds are in the all-info dump
  ASSERT_TRUE(Click("chkDimOriginSymb"));
  ASSERT_TRUE(Click("chkDetectChamfer"));
  EXPECT_EQ(Written("SetSysDimOriginSymb"), std::vector<double>{0});
  EXPECT_EQ(Written("SetSysDimDetectChamfer"), std::vector<double>{1});
  EXPECT_EQ(_script.calls.size(), 2u);
}

// What each radio group shows and writes is a test of every page; here a page initialised again
// shows the new stored value.
TEST_F(DimPage, InitializeAgainShowsTheStoredRadio) {
  Open();
  EXPECT_EQ(Selected(kCircle), "_radioDimCircleCenter");
  _script.values["DimCreateCircle"] = {1};
  _pPage->Initialize();
  EXPECT_EQ(Selected(kCircle), "_radioDimCircleEdge");
  EXPECT_TRUE(_script.calls.empty());
}

TEST_F(DimPage, FollowingTheCursorDisablesTheLinePosition) {
  _script.values["DimFollowMouse"] = {1};
  Open();
  ZEPDlgSpinner* position = Spinner("editorDimLinePosValue");
  EXPECT_FALSE(position->IsEffectivelyEnabled());
  EXPECT_FALSE(ZEPDlgDriver::Enter(position, 0.01));
  ASSERT_TRUE(Click("checkDimSketch"));
  EXPECT_TRUE(position->IsEffectivelyEnabled());
  ASSERT_TRUE(ZEPDlgDriver::Enter(position, 0.01));
  ASSERT_TRUE(Click("checkDimSketch"));
  EXPECT_FALSE(position->IsEffectivelyEnabled());
  EXPECT_EQ(Written("SetSysDimFollowMouse"), (std::vector<double>{0, 1}));
  EXPECT_EQ(Written("SetSysDimConstantOffsetValue"), std::vector<double>{10.0});

  // A locked line position stays disabled whatever the cursor rule says.
  _script.calls.clear();
  _script.allInfoSet = true;
  _script.locked = {"DimConstantOffsetValue"};
  Open();
  ASSERT_TRUE(Click("checkDimSketch"));
  EXPECT_EQ(Written("SetSysDimFollowMouse"), std::vector<double>{0});
  EXPECT_FALSE(Spinner("editorDimLinePosValue")->IsEffectivelyEnabled());
  EXPECT_EQ(ZEPDlgDriver::WhyNotOperable(Spinner("editorDimLinePosValue")), "locked by test administrator");
}

TEST_F(DimPage, FunnelNeedsCumulatedValues) {
  _script.info["DimCumulAddFunnel"] = 0;
  _script.values = {{"DimAlignCumulValue", {1}}, {"DimCumulAddFunnel", {1}}};
  Open();
  ZEPDialog* funnel = Control("checkLineUpAutoFunnel");
  EXPECT_TRUE(funnel->IsEffectivelyEnabled());
  ASSERT_TRUE(Click("checkLineUpCumulVal"));
  EXPECT_FALSE(funnel->IsEffectivelyEnabled());
  EXPECT_TRUE(Checked("checkLineUpAutoFunnel")); // disabled, not changed
  EXPECT_FALSE(ZEPDlgDriver::Click(funnel));
  ASSERT_TRUE(Click("checkLineUpCumulVal"));
  ASSERT_TRUE(ZEPDlgDriver::Click(funnel));
  EXPECT_EQ(Written("SetSysDimAlignCumulValue"), (std::vector<double>{0, 1}));
  EXPECT_EQ(Written("SetSysDimCumulAddFunnel"), std::vector<double>{0});
  EXPECT_EQ(_script.calls.size(), 3u);

  // Stored without cumulated values the funnel starts disabled.
  _script.values["DimAlignCumulValue"] = {0};
  Open();
  EXPECT_FALSE(Enabled("checkLineUpAutoFunnel"));

  // A locked funnel stays disabled when cumulated values are turned on.
  _script.locked = {"DimCumulAddFunnel"};
  Open();
  ASSERT_TRUE(Click("checkLineUpCumulVal"));
  EXPECT_FALSE(Enabled("checkLineUpAutoFunnel"));
}

TEST_F(DimPage, LengthsInMillimetresAndAnglesInDegreesAtTheHooks) {
  _script.values = {{"DimConstantOffsetValue", {12.5}},
                    {"DimOffsetRefMM", {3}},
                    {"DimOffsetRefDeg", {90}},
                    {"DimOffsetBetMM", {-7}},
                    {"DimOffsetBetDeg", {-45}}};
  Open();
  EXPECT_DOUBLE_EQ(Spinner("editorDimLinePosValue")->GetValue(), 0.0125);
  EXPECT_DOUBLE_EQ(Spinner("_editorLineUpBaseOffsetLength")->GetValue(), 0.003);
  EXPECT_DOUBLE_EQ(Spinner("_editorLineUpOffsetLength")->GetValue(), -0.007);
  EXPECT_EQ(Spinner("_editorLineUpBaseOffsetAngle")->GetValue(), 1.5707963267949054);
  EXPECT_NEAR(Spinner("_editorLineUpOffsetAngle")->GetValue(), -kPi / 4, 1e-12);
  EXPECT_EQ(Spinner("editorDimLinePosValue")->GetUnit(), 45);        // millimetres on paper
  EXPECT_EQ(Spinner("_editorLineUpBaseOffsetAngle")->GetUnit(), 12); // degrees

  ASSERT_TRUE(ZEPDlgDriver::Enter(Spinner("editorDimLinePosValue"), 0.02));
  ASSERT_TRUE(ZEPDlgDriver::Enter(Spinner("_editorLineUpBaseOffsetLength"), 0.005));
  ASSERT_TRUE(ZEPDlgDriver::Enter(Spinner("_editorLineUpBaseOffsetAngle"), kPi / 4));
  ASSERT_TRUE(ZEPDlgDriver::Enter(Spinner("_editorLineUpOffsetLength"), 0.25));
  ASSERT_TRUE(ZEPDlgDriver::Enter(Spinner("_editorLineUpOffsetAngle"), -kPi / 2));
  ASSERT_EQ(_script.calls.size(), 5u);
  EXPECT_DOUBLE_EQ(Written("SetSysDimConstantOffsetValue").at(0), 20.0);
  EXPECT_DOUBLE_EQ(Written("SetSysDimOffsetRefMM").at(0), 5.0);
  EXPECT_EQ(Written("SetSysDimOffsetRefDeg").at(0), 44.99999999999975);
  EXPECT_DOUBLE_EQ(Written("SetSysDimOffsetBetMM").at(0), 250.0);
  EXPECT_NEAR(Written("SetSysDimOffsetBetDeg").at(0), -90.0, 1e-9);
}

// Paper lengths follow the paper unit, not the model unit; values at the hooks stay millimetres.
TEST_F(DimPage, LengthsInInchesOnPaper) {
  int inch = 5;
  ASSERT_EQ(_pOptions->WriteAttr("DrwPaperLengthUnit", &inch, 1), 1);
  ASSERT_TRUE(ZEPCkeUnitsSetup::SetLengthUnit("METER"));
  ASSERT_TRUE(ZEPCkeUnitsSetup::SetAngleUnit("RADIAN"));
  _script.values["DimConstantOffsetValue"] = {25.4};
  Open();
  for (const char* name : {"editorDimLinePosValue", "_editorLineUpBaseOffsetLength", "_editorLineUpOffsetLength"}) {
    ZEPDlgSpinner* length = Spinner(name);
    EXPECT_EQ(length->GetUnit(), 48) << name; // inches
    double min = 0, max = 0, step = 0;
    length->GetMinMaxStep(min, max, step);
    EXPECT_DOUBLE_EQ(min, -1.0) << name;
    EXPECT_DOUBLE_EQ(max, 1.0) << name;
    EXPECT_DOUBLE_EQ(step, 0.0001) << name; // a tenth of a millimetre for inches
  }
  for (const char* name : {"_editorLineUpBaseOffsetAngle", "_editorLineUpOffsetAngle"})
    EXPECT_EQ(Spinner(name)->GetUnit(), 11) << name; // radians
  EXPECT_DOUBLE_EQ(Spinner("editorDimLinePosValue")->GetValue(), 0.0254);
  ASSERT_TRUE(ZEPDlgDriver::Enter(Spinner("editorDimLinePosValue"), 0.0508));
  EXPECT_DOUBLE_EQ(Written("SetSysDimConstantOffsetValue").at(0), 50.8);
}

TEST_F(DimPage, Assoc3DDialogOpenedOperatedAndClosed) {
  _script.info["DimAssoc3DMod"] = 0;
  _script.values = {{"DimAssoc3DMod", {2}}, {"AssocDimOnApproximate", {1}}};
  Open();
  ZEPDlgDialog* dialog = PushAssoc3D();
  ASSERT_NE(dialog, nullptr);
  EXPECT_EQ(dialog->GetVisibility(), ZEPDlgShow);
  // A second press shows the open dialog (behind the page, say) and creates none.
  dialog->SetVisibility(ZEPDlgHide);
  ASSERT_TRUE(Click("pushAssoc3D"));
  ASSERT_EQ(Dialogs(), std::vector<ZEPDialog*>{dialog});
  EXPECT_EQ(dialog->GetVisibility(), ZEPDlgShow);
  EXPECT_EQ(Selected(kForce2D), "_radioDimForce2DAlways");
  EXPECT_TRUE(Checked("chkAssocDimOnApproximate"));

  ASSERT_TRUE(Click("_radioDimForce2DWhenPb", dialog));
  ASSERT_TRUE(Click("chkAssocDimOnApproximate", dialog));
  EXPECT_EQ(Written("SetSysDimAssoc3DMod"), std::vector<double>{1});
  EXPECT_EQ(Written("SetSysAssocDimOnApproximate"), std::vector<double>{0});

  // Either close button: the dialog stays on screen until idle time but no longer writes.
  for (bool windowButton : {false, true}) {
    _script.calls.clear();
    ASSERT_TRUE(windowButton ? ZEPDlgDriver::Close(dialog) : ZEPDlgDriver::CloseDialog(dialog));
    ASSERT_EQ(Dialogs().size(), 1u);
    ASSERT_TRUE(Click("_radioDimForce2DNever", dialog));
    ASSERT_TRUE(Click("chkAssocDimOnApproximate", dialog));
    ASSERT_TRUE(ZEPDlgDriver::CloseDialog(dialog)); // a second close changes nothing either
    EXPECT_TRUE(_script.calls.empty()) << windowButton;
    ZEPDlgDriver::Idle();
    EXPECT_TRUE(Dialogs().empty());

    // A fresh dialog shows the values last written, not what the closed one showed.
    dialog = PushAssoc3D();
    ASSERT_NE(dialog, nullptr);
    EXPECT_EQ(Selected(kForce2D), "_radioDimForce2DWhenPb");
    EXPECT_FALSE(Checked("chkAssocDimOnApproximate"));
  }
  // The page may go before idle time with its closed dialog still waiting for destruction.
  ASSERT_TRUE(ZEPDlgDriver::CloseDialog(dialog));
  delete _pWindow;
  _pWindow = nullptr;
  ZEPDlgDriver::Idle();
  EXPECT_TRUE(_root.GetChildren().empty());
}

TEST_F(DimPage, LocksInsideTheAssoc3DDialog) {
  // Only the mode has lock information; the approximate flag's hook leaves its record alone.
  _script.info["DimAssoc3DMod"] = 0;
  _script.locked = {"DimAssoc3DMod"};
  Open();
  ZEPDlgDialog* dialog = PushAssoc3D();
  ASSERT_NE(dialog, nullptr);
  for (const char* name : kForce2D) {
    EXPECT_FALSE(Radio(name, dialog)->IsEffectivelyEnabled()) << name;
    EXPECT_FALSE(Click(name, dialog)) << name;
  }
  // Each setting of the dialog has a lock record of its own.
  ZEPDialog* approximate = Control("chkAssocDimOnApproximate", dialog);
  EXPECT_EQ(ZEPDlgDriver::WhyNotOperable(approximate), "");
  ASSERT_TRUE(ZEPDlgDriver::Click(approximate));
  ASSERT_EQ(_script.calls.size(), 1u);
  EXPECT_EQ(_script.calls[0].hook, "SetSysAssocDimOnApproximate");
  ASSERT_TRUE(ZEPDlgDriver::CloseDialog(dialog));
  ZEPDlgDriver::Idle();

  _script.calls.clear();
  _script.allInfoSet = true;
  _script.locked = {"AssocDimOnApproximate"};
  Open();
  dialog = PushAssoc3D();
  ASSERT_NE(dialog, nullptr);
  EXPECT_EQ(ZEPDlgDriver::WhyNotOperable(Control("chkAssocDimOnApproximate", dialog)), "locked by test administrator");
  ASSERT_TRUE(Click("_radioDimForce2DWhenPb", dialog));
  EXPECT_EQ(Written("SetSysDimAssoc3DMod"), std::vector<double>{1});
  EXPECT_EQ(_script.calls.size(), 1u);
}

TEST_F(DimPage, RegisteredWithTheObjectModel) {
  Open();
  // Registered under its name, as a frame, and cast to from the host's base interface.
  const ZEPMetaObject* meta = _pPage->GetMetaObject();
  EXPECT_EQ(ZEPFindMetaObject("ZEP2DBaseOptDimFrm"), meta);
  EXPECT_EQ(meta->GetBase(), ZEPDlgFrame::MetaObject());
  EXPECT_EQ(ZEPSysDynamicCast<ZEP2DBaseOptDimFrm>(static_cast<ZEPBaseUnknown*>(_pPage)), _pPage);
}
