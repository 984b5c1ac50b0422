// Primary view page: optional rows and the offset on the sheet.
#include "RecordingPages.h"

namespace {
class PrimaryViewPage : public ZEPHostTest {
protected:
  void Open() { _pPage = OpenPage<RecordingPrimaryViewPage>(_script, &_root); }
  short Row(const char* iName) { return ZEPDlgDriver::Find(_pPage, iName)->GetGridConstraints().row; }
  short Column(const char* iName) { return ZEPDlgDriver::Find(_pPage, iName)->GetGridConstraints().column; }
  HookScript _script;
  RecordingPrimaryViewPage* _pPage = nullptr;
};
} // namespace

TEST_F(PrimaryViewPage, ModuleHooksLeaveOptionalRowsOut) {
  Open();
  EXPECT_EQ(_pPage->GetOwnName(), "PrimaryViewFrame");
  EXPECT_EQ(ZEPDlgDriver::Find(_pPage, "spnDefaultOffsetBetViews"), nullptr);
  EXPECT_EQ(ZEPDlgDriver::Find(_pPage, "chkManage3DGridLabelDisplay"), nullptr);
  EXPECT_EQ(Row("RefElemSelLabel"), 0);
  EXPECT_EQ(Row("invLbl"), 1);
  EXPECT_EQ(Row("chkChangePrimaryViewPlane"), 1);
  EXPECT_EQ(Column("chkChangePrimaryViewPlane"), 1);
  EXPECT_EQ(Row("chkResizeViewBoxOn3D"), 2);
  EXPECT_EQ(_pPage->GetResourceFilename(0), "ZEP2DBasePrimaryViewFrm");
  EXPECT_EQ(_pPage->GetResourceFilename(1), _pPage->ZEPDlgFrame::GetResourceFilename(0));
  ExpectGolden("primary_view_page_module_hooks.dump", ZEPDlgDriver::Dump(_pPage));
}

TEST_F(PrimaryViewPage, AllInfoHooksAnsweringZero) {
  _script.allInfoSet = true;
  _script.values = {{"ResizeViewBoxOn3D", {1}}, {"DefaultOffsetBetViews", {20.0}}};
  Open();
  EXPECT_EQ(Row("spnDefaultOffsetBetViews"), 0);
  EXPECT_EQ(Row("RefElemSelLabel"), 1);
  EXPECT_EQ(Row("chkChangePrimaryViewPlane"), 2);
  EXPECT_EQ(Row("chkResizeViewBoxOn3D"), 3);
  EXPECT_EQ(Row("chkManage3DGridLabelDisplay"), 4);
  EXPECT_EQ(Column("chkManage3DGridLabelDisplay"), 0);
  ExpectGolden("primary_view_page_info_zero.dump", ZEPDlgDriver::Dump(_pPage));
}

TEST_F(PrimaryViewPage, OffsetIsAPaperLength) {
  _script.info["DefaultOffsetBetViews"] = 0;
  _script.values["DefaultOffsetBetViews"] = {20.0};
  ZEPSysSettingRepository* rep = ZEPSysSettingRepository::Open("DraftingOptions");
  int inch = 5;
  rep->WriteAttr("DrwPaperLengthUnit", &inch, 1);
  Open();
  auto* offset = ZEPSysDynamicCast<ZEPDlgSpinner>(ZEPDlgDriver::FindControl(_pPage, "spnDefaultOffsetBetViews"));
  ASSERT_NE(offset, nullptr);
  EXPECT_DOUBLE_EQ(offset->GetValue(), 0.02);
  EXPECT_EQ(offset->GetUnit(), 48); // inches on the sheet
  double mn = 0, mx = 0, step = 0;
  offset->GetMinMaxStep(mn, mx, step);
  EXPECT_DOUBLE_EQ(mx, 10.0);  // paper limits ignore the scale range
  EXPECT_DOUBLE_EQ(step, 0.001); // a tenth of the step in inches
  ASSERT_TRUE(ZEPDlgDriver::Enter(offset, 0.035));
  ASSERT_EQ(_script.calls.size(), 1u);
  EXPECT_EQ(_script.calls[0].hook, "SetSysDefaultOffsetBetViews");
  EXPECT_DOUBLE_EQ(_script.calls[0].values[0], 35.0);
}

TEST_F(PrimaryViewPage, SuccessCodeOtherThanZeroStillHidesTheOffset) {
  _script.info["DefaultOffsetBetViews"] = 1;
  Open();
  EXPECT_EQ(ZEPDlgDriver::Find(_pPage, "spnDefaultOffsetBetViews"), nullptr);
  EXPECT_EQ(ZEPDlgDriver::Find(_pPage, "pLblDefaultOffset"), nullptr);
}
