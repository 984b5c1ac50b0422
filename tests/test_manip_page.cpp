// Manipulators page: its build flag and layout option, the two matrices (each cell writes its
// own attribute whatever its place on screen), unit conversions and transparency rounding.
#include "RecordingPages.h"

#include <cmath>
#include <limits>
#include <set>

namespace {
using ManipPage = PageTest<RecordingManipPage>;
} // namespace

TEST_F(ManipPage, ModuleHooksShowZerosAndEveryGetterIsRead) {
  Open(); // the zeros are in the dump
  EXPECT_EQ(std::set<std::string>(_script.reads.begin(), _script.reads.end()).size(), kManipAttributes.size());
  EXPECT_EQ(ZEPCheckLog::Count(), 0);
  ExpectGolden("manip_page_module_hooks.dump", ZEPDlgDriver::Dump(_pPage));
}

TEST_F(ManipPage, BuildFlagAndLayoutOptionDecideTheDimensionRows) {
  const struct {
    int flag, option;
    bool dimensions, datum;
  } cases[] = {{1, 1, true, true}, {1, 0, false, true}, {0, 1, false, false}, {0, 0, false, false}};
  for (const auto& c : cases) {
    _script = HookScript();
    _script.options = {{"BuildFlag", c.flag}, {"WithDimManipSection", c.option}};
    Open();
    const std::string when = "flag " + std::to_string(c.flag) + " option " + std::to_string(c.option);
    EXPECT_EQ(Find("frameDim") != nullptr, c.dimensions) << when;
    EXPECT_EQ(Find("_checkDimORunCre") != nullptr, c.dimensions) << when;
    EXPECT_EQ(Find("_labelManipMovableDatum") != nullptr, c.datum) << when;
    EXPECT_EQ(Find("_checkManipMovableDatumMod") != nullptr, c.datum) << when;
    // Frames take the next free row: no gap where the dimension matrix is missing.
    EXPECT_EQ(Row("frameAnnotManip"), c.dimensions ? 5 : 4) << when;
    EXPECT_EQ(_script.reads.size(), 42u) << "rows not built are read all the same; " << when;
  }
}

TEST_F(ManipPage, EveryMatrixCellWritesItsOwnAttribute) {
  int count = 0;
  const ZEP2DBaseOptManipFrm::MatrixRow* rows = ZEP2DBaseOptManipFrm::MatrixRows(count);
  ASSERT_EQ(2 * count, 34);
  Open();
  for (int i = 0; i < count; ++i) {
    const bool dimension = i < ZEP2DBaseOptManipFrm::kDimensionRows;
    for (int column : {0, 1}) {
      const int slot = column ? rows[i].modSlot : rows[i].creSlot;
      const std::string name =
          std::string(dimension ? "_checkDim" : "_check") + rows[i].name + (column ? "Mod" : "Cre");
      ZEPDialog* check = Control(name);
      ASSERT_NE(check, nullptr) << name;
      // The cell sits in its row's grid row, in the check column of its side.
      const ZEPDialog::Cell& cell = check->GetParentDialog()->GetGridConstraints();
      EXPECT_EQ(cell.row, (dimension ? i : i - ZEP2DBaseOptManipFrm::kDimensionRows) + 1) << name;
      EXPECT_EQ(cell.column, column ? 4 : 2) << name;
      _script.calls.clear();
      ASSERT_TRUE(ZEPDlgDriver::Click(check)) << name;
      ASSERT_EQ(_script.calls.size(), 1u) << name;
      EXPECT_EQ(_script.calls[0].hook, std::string("SetSys") + kManipAttributes[slot]) << name;
      EXPECT_EQ(_script.calls[0].values[0], 1.0) << name;
    }
  }
  // Screen order of a few named rows: "ChangeSymbol" third on screen, last among the hooks.
  for (const auto& named : {std::pair<const char*, short>{"_checkDimChangeSymbolMod", 3},
                            {"_checkDimBeforeCre", 4},
                            {"_checkDimMoveLeaderCre", 9},
                            {"_checkManipRotateAnnotCre", 1},
                            {"_checkManipMovableDatumMod", 8}})
    EXPECT_EQ(Row(named.first), named.second) << named.first;
  // The row's text lives only in its label: the checks have none, but the label's help.
  EXPECT_TRUE(Find("_checkDimChangeSymbolCre")->GetTitle().IsEmpty());
  EXPECT_FALSE(Find("_labelDimChangeSymbol")->GetLongHelp().IsEmpty());
  EXPECT_EQ(Find("_labelIconDimChangeSymbol"), nullptr);
  EXPECT_EQ(Find("_labelIconChangeSymbol")->GetChildren().back()->GetIconName(), "S_DrwManipMoveLeader");
}

TEST_F(ManipPage, TransparencyIsAPercentRoundedToTheNearestPoint) {
  _script.values = {{"ManipTransparency", {35}}};
  Open();
  ZEPDlgSpinner* spinner = Spinner("editorManipTransparency");
  EXPECT_DOUBLE_EQ(spinner->GetValue(), 0.35);
  EXPECT_EQ(spinner->FormatValue(spinner->GetValue()), "35 %");
  EXPECT_EQ(spinner->GetRangeFlag(), 1);
  for (double entered : {0.29, 0.57, 0.58, 0.005, 0.004, 1.7, -2.0})
    ASSERT_TRUE(ZEPDlgDriver::Enter(spinner, entered)) << entered;
  EXPECT_EQ(Written("SetSysManipTransparency"), (std::vector<double>{29, 57, 58, 1, 0, 100, 0}));
  EXPECT_EQ(_script.calls.size(), 7u);
  // Values a user cannot enter still give a valid int.
  _script.calls.clear();
  for (double value : {std::nan(""), 1e12, -1e12}) {
    spinner->SetValue(value, 0);
    spinner->SendNotification(spinner->GetSpinnerModifyNotification());
  }
  EXPECT_EQ(Written("SetSysManipTransparency"),
            (std::vector<double>{0, std::numeric_limits<int>::max(), std::numeric_limits<int>::min()}));
}

TEST_F(ManipPage, LengthsInMillimetresAndAnglesInDegreesAtTheHooks) {
  _script.values = {{"ManipRefSize", {5.0}}, {"RotationSnapAngle", {15.0}}, {"PaperGridSpacing", {0.0}}};
  Open();
  EXPECT_DOUBLE_EQ(Spinner("editorManipRefSize")->GetValue(), 0.005);
  EXPECT_DOUBLE_EQ(Spinner("spinnerRotSnapAngle")->GetValue(), 0.2617993877991509);
  ASSERT_TRUE(ZEPDlgDriver::Enter(Spinner("editorManipRefSize"), 0.012));
  ASSERT_TRUE(ZEPDlgDriver::Enter(Spinner("spinnerRotSnapAngle"), std::atan(1.0)));
  ASSERT_TRUE(ZEPDlgDriver::Enter(Spinner("spinnerRotSnapAngle"), -1.0)); // may be negative
  ASSERT_TRUE(ZEPDlgDriver::Enter(Spinner("spnPaperGridSpacing"), 0.0));  // may be 0
  ASSERT_EQ(_script.calls.size(), 4u);
  EXPECT_EQ(_script.calls[0].hook, "SetSysManipRefSize");
  EXPECT_DOUBLE_EQ(_script.calls[0].values[0], 12.0);
  EXPECT_EQ(_script.calls[1].hook, "SetSysRotationSnapAngle");
  EXPECT_DOUBLE_EQ(_script.calls[1].values[0], 44.99999999999975);
  EXPECT_LT(_script.calls[2].values[0], -57.0);
  EXPECT_EQ(_script.calls[3].hook, "SetSysPaperGridSpacing");
  EXPECT_EQ(_script.calls[3].values[0], 0.0);
}

TEST_F(ManipPage, AllInfoHooksAnsweringZero) {
  _script.allInfoSet = true;
  _script.locked = {"DimBlankMod", "ManipTransparency"};
  _script.values = {
      {"ManipTransparency", {40}}, {"ManipZoom", {1}}, {"DimChangeSymbolCre", {1}}, {"ManipMovableDatumMod", {1}}};
  Open();
  EXPECT_FALSE(Enabled("_checkDimBlankMod"));
  EXPECT_FALSE(ZEPDlgDriver::Enter(Control("editorManipTransparency"), 0.5));
  EXPECT_TRUE(_script.calls.empty());
  ExpectGolden("manip_page_info_zero.dump", ZEPDlgDriver::Dump(_pPage));
}
