#include "TestSupport.h"

#include "ZEP2DBaseRangeCmb.h"

#include <string>
#include <vector>

class ZEP2DBaseRangeCmbTest : public ZEPHostTest {
protected:
  static std::string Name(int iScale) {
    return ZEPGlobalFunctions2::GetScalesServices()->GetScaleName(static_cast<ZEPCkeScale>(iScale)).str();
  }
  static std::string Selected(const ZEPDlgCombo& iCombo) { return ComboLine(iCombo, iCombo.ZEPDlgCombo::GetSelect()); }
  static constexpr const char* kSelectCheck =
      "0<=ZEPDlgCombo::SetSelect(spScaleServices->GetScaleName(GetMatchingRange(iIdx)), 0)";
};

TEST_F(ZEP2DBaseRangeCmbTest, ListsActivatedRangesInAscendingOrder) {
  ZEPScalesSetup::SetActivatedScales({5, 1, 3});
  ZEPScalesSetup::SetCurrentScale(3);
  auto* combo = new ZEP2DBaseRangeCmb(&_root, "cmbGridRange");
  EXPECT_EQ((std::vector<std::string>{Name(1), Name(3), Name(5)}), ComboLines(*combo));
  EXPECT_EQ(Name(3), Selected(*combo));
  EXPECT_EQ(3, combo->GetSelect());
  EXPECT_EQ(ZEPDlgShow, combo->GetVisibility());
  EXPECT_EQ(8, combo->GetVisibleTextWidth());

  // The user picks lines; the range follows the line's name.
  ASSERT_TRUE(ZEPDlgDriver::Select(combo, 0));
  EXPECT_EQ(1, combo->GetSelect());
  ASSERT_TRUE(ZEPDlgDriver::Select(combo, 2));
  EXPECT_EQ(5, combo->GetSelect());

  // Any index beyond 4 is range 5; the index itself is answered.
  EXPECT_EQ(1, combo->SetSelect(1, 1));
  EXPECT_EQ(7, combo->SetSelect(7, 1));
  EXPECT_EQ(Name(5), Selected(*combo));
  EXPECT_EQ(0, ZEPCheckLog::Count());

  // A range without a line is refused and reported; the selection stays.
  EXPECT_EQ(-1, combo->SetSelect(2, 0));
  EXPECT_TRUE(ZEPCheckLog::Contains(kSelectCheck));
  EXPECT_EQ(5, combo->GetSelect());
}

TEST_F(ZEP2DBaseRangeCmbTest, SingleRangeHidesTheComboWithoutAskingTheCurrentScale) {
  ZEPScalesSetup::SetActivatedScales({1});
  ZEPScalesSetup::SetCurrentScale(1);
  auto* one = new ZEP2DBaseRangeCmb(&_root, "cmbOne");
  EXPECT_EQ(ZEPDlgHide, one->GetVisibility());
  EXPECT_EQ(0, ZEPScalesSetup::CurrentScaleRequests());
  EXPECT_EQ(Name(1), Selected(*one));
  EXPECT_EQ(0, ZEPCheckLog::Count());

  // Range 1 is selected at first, and it has no line here.
  ZEPScalesSetup::SetActivatedScales({3});
  auto* three = new ZEP2DBaseRangeCmb(&_root, "cmbThree");
  EXPECT_EQ(ZEPDlgHide, three->GetVisibility());
  EXPECT_EQ(0, ZEPScalesSetup::CurrentScaleRequests());
  EXPECT_EQ(-1, three->ZEPDlgCombo::GetSelect());
  EXPECT_EQ(1, ZEPCheckLog::Count());
  EXPECT_TRUE(ZEPCheckLog::Contains(kSelectCheck));
}

TEST_F(ZEP2DBaseRangeCmbTest, CurrentScaleOutsideTheRangesSelectsRangeOne) {
  for (int current : {0, 7}) {
    ZEPScalesSetup::SetCurrentScale(current);
    auto* combo = new ZEP2DBaseRangeCmb(&_root, "cmbRange" + std::to_string(current));
    EXPECT_EQ(Name(1), Selected(*combo)) << current;
  }
  EXPECT_EQ(2, ZEPScalesSetup::CurrentScaleRequests());
}

TEST_F(ZEP2DBaseRangeCmbTest, MatchingRange) {
  for (int i : {1, 2, 3, 4}) EXPECT_EQ(i, ZEP2DBaseRangeCmb::GetMatchingRange(i));
  for (int i : {0, -3, 5, 9}) EXPECT_EQ(ZEPCkeScaleExtraSmall, ZEP2DBaseRangeCmb::GetMatchingRange(i)) << i;
}

TEST_F(ZEP2DBaseRangeCmbTest, BadActivatedListsAndMissingServiceAreReported) {
  ZEPScalesSetup::SetActivatedScales({2, 2, 9});
  auto* bad = new ZEP2DBaseRangeCmb(&_root, "cmbBad");
  EXPECT_EQ((std::vector<std::string>{Name(2)}), ComboLines(*bad));
  EXPECT_TRUE(ZEPCheckLog::Contains("GetLineCount()==_activatedScales.Size()"));

  ZEPCheckLog::Clear();
  ZEPScalesSetup::SetAvailable(false);
  auto* combo = new ZEP2DBaseRangeCmb(&_root, "cmbNoService");
  EXPECT_EQ(0, combo->GetLineCount());
  EXPECT_EQ(ZEPDlgShow, combo->GetVisibility());
  EXPECT_EQ(0, combo->GetVisibleTextWidth());
  EXPECT_EQ(-1, combo->GetSelect());
  EXPECT_EQ(-1, combo->SetSelect(1, 0));
  ASSERT_EQ(3, ZEPCheckLog::Count());
  for (const ZEPCheckEntry& e : ZEPCheckLog::Entries()) {
    EXPECT_EQ("spScaleServices", e.expression);
    EXPECT_EQ("Check_Handler_Failed__", e.reporter);
    EXPECT_EQ("DraftingBaseSettings/ZEPDbsBaseSettings.m/src/ZEP2DBaseRangeCmb", e.path);
  }
}
