// General page: axis length conversion, the paper unit combo and its mapping.
#include "RecordingPages.h"

namespace {
class GalPage : public ZEPHostTest {
protected:
  void Open() { _pPage = OpenPage<RecordingGalPage>(_script, &_root); }
  ZEPDlgCombo* UnitCombo() {
    return ZEPSysDynamicCast<ZEPDlgCombo>(ZEPDlgDriver::FindControl(_pPage, "cmbPaperLengthUnit"));
  }
  std::string SelectedUnit() {
    ZEPUnicodeString text;
    UnitCombo()->GetLine(text, UnitCombo()->GetSelect());
    return text.str();
  }
  HookScript _script;
  RecordingGalPage* _pPage = nullptr;
};
} // namespace

TEST_F(GalPage, ModuleHooksShowZerosAndMillimetres) {
  Open();
  for (const char* name : {"chkCopyFirstSheetBckg", "checkViewFrame", "checkViewReferential", "checkViewRefZoom"})
    EXPECT_EQ(ZEPSysDynamicCast<ZEPDlgCheckButton>(ZEPDlgDriver::FindControl(_pPage, name))->GetState(),
              ZEPDlgUnchecked)
        << name;
  auto* axis = ZEPSysDynamicCast<ZEPDlgSpinner>(ZEPDlgDriver::FindControl(_pPage, "spinnerViewAxisSize"));
  EXPECT_EQ(axis->GetValue(), 0.0);
  EXPECT_EQ(UnitCombo()->GetLineCount(), 3);
  EXPECT_EQ(SelectedUnit(), ZEPMsgCatalog::BuildMessage("ZEP2DBaseOptGalFrm", "mmUnit").str());
  EXPECT_FALSE(SelectedUnit().empty()); // the catalog has the text
  ExpectGolden("gal_page_module_hooks.dump", ZEPDlgDriver::Dump(_pPage));
}

TEST_F(GalPage, AllInfoHooksAnsweringZero) {
  _script.allInfoSet = true;
  _script.values = {{"CopyFirstSheetBckg", {1}}, {"2DAxisZoom", {1}}, {"2DAxisLength", {25}}, {"PaperLengthUnit", {5}}};
  Open();
  ExpectGolden("gal_page_info_zero.dump", ZEPDlgDriver::Dump(_pPage));
}

TEST_F(GalPage, AxisLengthInMillimetresAtTheHooks) {
  _script.values["2DAxisLength"] = {25.0};
  Open();
  auto* axis = ZEPSysDynamicCast<ZEPDlgSpinner>(ZEPDlgDriver::FindControl(_pPage, "spinnerViewAxisSize"));
  EXPECT_DOUBLE_EQ(axis->GetValue(), 0.025);
  EXPECT_EQ(axis->GetUnit(), 45); // the user's millimetres
  ASSERT_TRUE(ZEPDlgDriver::Enter(axis, 0.04));
  ASSERT_EQ(_script.calls.size(), 1u);
  EXPECT_EQ(_script.calls[0].hook, "SetSys2DAxisLength");
  EXPECT_DOUBLE_EQ(_script.calls[0].values[0], 40.0);
}

TEST_F(GalPage, PaperUnitLinesAndCodes) {
  const struct {
    int stored;
    const char* key;
  } cases[] = {{1, "mmUnit"}, {3, "cmUnit"}, {5, "inUnit"}, {2, "mmUnit"}, {4, "mmUnit"}, {-7, "mmUnit"}};
  for (const auto& c : cases) {
    _script.values["PaperLengthUnit"] = {double(c.stored)};
    auto* window = new ZEPDlgWindow(&_root, "window", 0); // a fresh page each time
    _pPage = OpenPage<RecordingGalPage>(_script, window);
    EXPECT_EQ(SelectedUnit(), ZEPMsgCatalog::BuildMessage("ZEP2DBaseOptGalFrm", c.key).str()) << c.stored;
    delete window;
  }
  EXPECT_TRUE(_script.calls.empty());
  // The user picks each line in turn: 1, 3, 5 are written.
  Open();
  for (int line : {1, 2, 0}) ASSERT_TRUE(ZEPDlgDriver::Select(UnitCombo(), line));
  std::vector<double> written;
  for (const HookCall& call : _script.Calls("SetSysPaperLengthUnit")) written.push_back(call.values[0]);
  EXPECT_EQ(written, (std::vector<double>{3, 5, 1}));
}

TEST_F(GalPage, ReinitialisingKeepsThreeUnitLines) {
  _script.values["PaperLengthUnit"] = {3};
  Open();
  _pPage->Initialize();
  _pPage->Initialize();
  EXPECT_EQ(UnitCombo()->GetLineCount(), 3);
  EXPECT_EQ(UnitCombo()->GetSelect(), 1);
}
