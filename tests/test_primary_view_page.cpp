// Primary view page: optional rows and the offset on the sheet.
#include "RecordingPages.h"

namespace {
using PrimaryViewPage = PageTest<RecordingPrimaryViewPage>;
} // namespace

// Which rows are built, and where, with the module's hooks and with every info hook answering 0,
// is in the dumps.
TEST_F(PrimaryViewPage, ModuleHooksLeaveOptionalRowsOut) {
  Open();
  ExpectGolden("primary_view_page_module_hooks.dump", ZEPDlgDriver::Dump(_pPage));
  _script.allInfoSet = true;
  _script.values = {{"ResizeViewBoxOn3D", {1}}, {"DefaultOffsetBetViews", {20.0}}};
  Open();
  ExpectGolden("primary_view_page_info_zero.dump", ZEPDlgDriver::Dump(_pPage));
  // A success code other than 0 still hides the offset and its label.
  _script.allInfoSet = false;
  _script.info["DefaultOffsetBetViews"] = 1;
  Open();
  EXPECT_EQ(Find("spnDefaultOffsetBetViews"), nullptr);
  EXPECT_EQ(Find("pLblDefaultOffset"), nullptr);
}

TEST_F(PrimaryViewPage, OffsetIsAPaperLength) {
  _script.info["DefaultOffsetBetViews"] = 0;
  _script.values["DefaultOffsetBetViews"] = {20.0};
  int inch = 5;
  _pOptions->WriteAttr("DrwPaperLengthUnit", &inch, 1);
  Open();
  ZEPDlgSpinner* offset = Spinner("spnDefaultOffsetBetViews");
  ASSERT_NE(offset, nullptr);
  EXPECT_DOUBLE_EQ(offset->GetValue(), 0.02);
  EXPECT_EQ(offset->GetUnit(), 48); // inches on the sheet
  double mn = 0, mx = 0, step = 0;
  offset->GetMinMaxStep(mn, mx, step);
  EXPECT_DOUBLE_EQ(mx, 10.0);    // paper limits ignore the scale range
  EXPECT_DOUBLE_EQ(step, 0.001); // a tenth of the step in inches
  ASSERT_TRUE(ZEPDlgDriver::Enter(offset, 0.035));
  EXPECT_EQ(Hooks(), std::vector<std::string>{"SetSysDefaultOffsetBetViews"});
  EXPECT_DOUBLE_EQ(_script.calls.at(0).values[0], 35.0);
}
