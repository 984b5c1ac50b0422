// Grid page: per-range values, unit conversion at the page edge, the distortion rule.
#include "RecordingPages.h"

#include "ZEP2DBaseRangeCmb.h"
#include "ZEPDrwLockCheckButton.h"
#include "ZEPDrwLockSpinner.h"

namespace {
class GridPage : public PageTest<RecordingGridPage> {
protected:
  // Scripted values of every per-range attribute, distinct per range.
  void ScriptRanges() {
    _script.values["PrimSpaceH"] = {100, 200, 300, 400, 500};
    _script.values["PrimSpaceV"] = {10, 20, 30, 40, 50};
    _script.values["GradH"] = {1, 2, 3, 4, 5};
    _script.values["GradV"] = {6, 7, 8, 9, 10};
  }
  bool SelectRange(int iRange) { // all five ranges are activated
    return ZEPDlgDriver::Select(As<ZEP2DBaseRangeCmb>("cmbGridRange"), iRange - 1);
  }
};
} // namespace

TEST_F(GridPage, ModuleHooksAndAllInfoHooksAnsweringZero) {
  Open(); // the zeros, the disabled vertical values and no snap check are in the dump
  EXPECT_EQ(_script.reads, (std::vector<std::string>{"DisplayGrid", "SnapToPoint", "AllowDistortions", "PrimSpaceH",
                                                     "PrimSpaceV", "GradH", "GradV"}));
  ExpectGolden("grid_page_module_hooks.dump", ZEPDlgDriver::Dump(_pPage));
  _script = HookScript();
  _script.allInfoSet = true;
  _script.values["DisplayGrid"] = {1};
  _script.values["SnapToPoint"] = {1};
  ScriptRanges();
  Open();
  ExpectGolden("grid_page_info_zero.dump", ZEPDlgDriver::Dump(_pPage));
}

TEST_F(GridPage, SpacingInMillimetresAtTheHooksAndMetresInTheSpinner) {
  ScriptRanges();
  Open();
  EXPECT_DOUBLE_EQ(Spinner("editorGridSpacing")->GetValue(), 0.1);
  EXPECT_DOUBLE_EQ(Spinner("editorGridSpacingV")->GetValue(), 0.1); // mirrors: distortion off

  ASSERT_TRUE(ZEPDlgDriver::Enter(Spinner("editorGridSpacing"), 2.5));
  std::vector<HookCall> calls = _script.Calls("SetSysPrimSpaceH");
  ASSERT_EQ(calls.size(), 1u);
  EXPECT_EQ(calls[0].values, (std::vector<double>{2500, 200, 300, 400, 500}));
  EXPECT_DOUBLE_EQ(Spinner("editorGridSpacingV")->GetValue(), 2.5);
  EXPECT_TRUE(_script.Calls("SetSysPrimSpaceV").empty()); // mirrored, not written
  EXPECT_EQ(_script.calls.size(), 1u);
}

TEST_F(GridPage, SwitchingTheRangeShowsItsValuesAndScaledLimits) {
  ScriptRanges();
  _script.values["AllowDistortions"] = {0, 0, 1, 0, 0};
  Open();
  ASSERT_TRUE(SelectRange(3));
  EXPECT_DOUBLE_EQ(Spinner("editorGridSpacing")->GetValue(), 0.3);
  EXPECT_DOUBLE_EQ(Spinner("editorGridSpacingV")->GetValue(), 0.03);
  EXPECT_EQ(Spinner("editorGridGraduation")->GetCurrentValue(), 3.f);
  EXPECT_EQ(Spinner("editorGridGraduationV")->GetCurrentValue(), 8.f);
  EXPECT_TRUE(Spinner("editorGridSpacingV")->IsEffectivelyEnabled());
  double mn = -1, mx = 0, step = 0;
  Spinner("editorGridSpacing")->GetMinMaxStep(mn, mx, step);
  EXPECT_DOUBLE_EQ(mn, 0.0);
  EXPECT_DOUBLE_EQ(mx, 1000000.0);
  EXPECT_DOUBLE_EQ(step, 0.005); // the step is not scaled
  Spinner("editorGridSpacingV")->GetMinMaxStep(mn, mx, step);
  EXPECT_DOUBLE_EQ(mx, 100000.0);
  EXPECT_DOUBLE_EQ(step, 0.005);

  // A change now lands in entry 2 and nowhere else.
  ASSERT_TRUE(ZEPDlgDriver::Enter(Spinner("editorGridSpacingV"), 0.035));
  EXPECT_EQ(_script.Calls("SetSysPrimSpaceV").at(0).values, (std::vector<double>{10, 20, 35, 40, 50}));
  // Back to range 1: its own values again, distortion off there.
  ASSERT_TRUE(SelectRange(1));
  EXPECT_DOUBLE_EQ(Spinner("editorGridSpacingV")->GetValue(), 0.1);
  EXPECT_FALSE(Spinner("editorGridSpacingV")->IsEffectivelyEnabled());
  EXPECT_EQ(_script.calls.size(), 1u); // switching ranges writes nothing
}

TEST_F(GridPage, DistortionRule) {
  ScriptRanges();
  Open();
  ASSERT_TRUE(SelectRange(2));
  ZEPDialog* distortion = Control("checkAllowDistortions");
  EXPECT_FALSE(ZEPDlgDriver::Enter(Spinner("editorGridSpacingV"), 1.0)); // disabled while off

  ASSERT_TRUE(ZEPDlgDriver::Click(distortion));
  EXPECT_EQ(_script.Calls("SetSysAllowDistortions").at(0).values, (std::vector<double>{0, 1, 0, 0, 0}));
  EXPECT_TRUE(Spinner("editorGridSpacingV")->IsEffectivelyEnabled());
  EXPECT_DOUBLE_EQ(Spinner("editorGridSpacingV")->GetValue(), 0.2); // keeps what it showed
  ASSERT_TRUE(ZEPDlgDriver::Enter(Spinner("editorGridSpacingV"), 0.05));
  ASSERT_TRUE(ZEPDlgDriver::Enter(Spinner("editorGridGraduationV"), 12.9));
  EXPECT_EQ(_script.Calls("SetSysPrimSpaceV").at(0).values, (std::vector<double>{10, 50, 30, 40, 50}));
  EXPECT_EQ(_script.Calls("SetSysGradV").at(0).values, (std::vector<double>{6, 12, 8, 9, 10}));
  EXPECT_EQ(Spinner("editorGridGraduationV")->GetCurrentValue(), 12.f); // truncated and shown

  // Off again: vertical controls disabled and showing the horizontal values, not written.
  _script.calls.clear();
  ASSERT_TRUE(ZEPDlgDriver::Click(distortion));
  EXPECT_EQ(_script.calls.size(), 1u);
  EXPECT_EQ(_script.calls[0].values, (std::vector<double>{0, 0, 0, 0, 0}));
  EXPECT_FALSE(Spinner("editorGridSpacingV")->IsEffectivelyEnabled());
  EXPECT_DOUBLE_EQ(Spinner("editorGridSpacingV")->GetValue(), 0.2);
  EXPECT_EQ(Spinner("editorGridGraduationV")->GetCurrentValue(), 2.f);
  ASSERT_TRUE(ZEPDlgDriver::Enter(Spinner("editorGridGraduation"), 7));
  EXPECT_EQ(Spinner("editorGridGraduationV")->GetCurrentValue(), 7.f);
  EXPECT_TRUE(_script.Calls("SetSysGradV").empty());
}

TEST_F(GridPage, GraduationThatChangesNothingWritesNothing) {
  ScriptRanges();
  Open();
  ASSERT_TRUE(ZEPDlgDriver::Enter(Spinner("editorGridGraduation"), 1.6)); // truncates to the stored 1
  EXPECT_TRUE(_script.calls.empty());
  EXPECT_EQ(Spinner("editorGridGraduation")->GetCurrentValue(), 1.6f); // the page does not rewrite an unchanged value
  ASSERT_TRUE(ZEPDlgDriver::Enter(Spinner("editorGridGraduation"), 4.2));
  EXPECT_EQ(_script.Calls("SetSysGradH").at(0).values, (std::vector<double>{4, 2, 3, 4, 5}));
  EXPECT_EQ(Spinner("editorGridGraduation")->GetCurrentValue(), 4.f);
}

TEST_F(GridPage, LockedVerticalSpacingStaysDisabledWhenDistortionEnablesIt) {
  _script.allInfoSet = true;
  _script.locked = {"PrimSpaceV"};
  Open();
  ASSERT_TRUE(Click("checkAllowDistortions"));
  EXPECT_TRUE(Spinner("editorGridGraduationV")->IsEffectivelyEnabled());
  EXPECT_FALSE(Spinner("editorGridSpacingV")->IsEffectivelyEnabled());
  EXPECT_FALSE(ZEPDlgDriver::Enter(Spinner("editorGridSpacingV"), 1.0));
  EXPECT_TRUE(_script.Calls("SetSysPrimSpaceV").empty());
}

TEST_F(GridPage, UnavailableScalesServiceKeepsTheRange) {
  ScriptRanges();
  Open();
  ASSERT_TRUE(SelectRange(4));
  ZEPScalesSetup::SetAvailable(false);
  ASSERT_TRUE(SelectRange(2));
  EXPECT_DOUBLE_EQ(Spinner("editorGridSpacing")->GetValue(), 0.4); // still range 4
  ASSERT_TRUE(ZEPDlgDriver::Enter(Spinner("editorGridSpacing"), 1.0));
  EXPECT_EQ(_script.Calls("SetSysPrimSpaceH").at(0).values, (std::vector<double>{100, 200, 300, 1000, 500}));
}
