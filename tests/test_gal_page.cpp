// General page: axis length conversion, the paper unit combo and its mapping.
#include "RecordingPages.h"

namespace {
class GalPage : public PageTest<RecordingGalPage> {
protected:
  std::string SelectedUnit() {
    return ComboLine(*Combo("cmbPaperLengthUnit"), Combo("cmbPaperLengthUnit")->GetSelect());
  }
};
} // namespace

// What each control shows, with the module's hooks and with every info hook answering 0, is in
// the dumps.
TEST_F(GalPage, ModuleHooksAndAllInfoHooksAnsweringZero) {
  Open();
  ExpectGolden("gal_page_module_hooks.dump", ZEPDlgDriver::Dump(_pPage));
  _script.allInfoSet = true;
  _script.values = {{"CopyFirstSheetBckg", {1}}, {"2DAxisZoom", {1}}, {"2DAxisLength", {25}}, {"PaperLengthUnit", {5}}};
  Open();
  ExpectGolden("gal_page_info_zero.dump", ZEPDlgDriver::Dump(_pPage));
}

TEST_F(GalPage, AxisLengthInMillimetresAtTheHooks) {
  _script.values["2DAxisLength"] = {25.0};
  Open();
  ZEPDlgSpinner* axis = Spinner("spinnerViewAxisSize");
  EXPECT_DOUBLE_EQ(axis->GetValue(), 0.025);
  EXPECT_EQ(axis->GetUnit(), 45); // the user's millimetres
  ASSERT_TRUE(ZEPDlgDriver::Enter(axis, 0.04));
  EXPECT_EQ(Hooks(), std::vector<std::string>{"SetSys2DAxisLength"});
  EXPECT_DOUBLE_EQ(_script.calls.at(0).values[0], 40.0);
}

TEST_F(GalPage, PaperUnitLinesAndCodes) {
  const struct {
    int stored;
    const char* key;
  } cases[] = {{1, "mmUnit"}, {3, "cmUnit"}, {5, "inUnit"}, {2, "mmUnit"}, {4, "mmUnit"}, {-7, "mmUnit"}};
  for (const auto& c : cases) {
    _script.values["PaperLengthUnit"] = {double(c.stored)};
    Open();
    EXPECT_EQ(SelectedUnit(), ZEPMsgCatalog::BuildMessage("ZEP2DBaseOptGalFrm", c.key).str()) << c.stored;
  }
  EXPECT_TRUE(_script.calls.empty());
  // The user picks each line in turn: 1, 3, 5 are written.
  Open();
  for (int line : {1, 2, 0}) ASSERT_TRUE(ZEPDlgDriver::Select(Combo("cmbPaperLengthUnit"), line));
  EXPECT_EQ(Written("SetSysPaperLengthUnit"), (std::vector<double>{3, 5, 1}));
  // Initialised again, it still has three lines.
  _script.values["PaperLengthUnit"] = {3};
  _pPage->Initialize();
  _pPage->Initialize();
  EXPECT_EQ(Combo("cmbPaperLengthUnit")->GetLineCount(), 3);
  EXPECT_EQ(Combo("cmbPaperLengthUnit")->GetSelect(), 1);
}
