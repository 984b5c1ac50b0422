#include "TestSupport.h"

#include "ZEPDrwLockCheckButton.h"
#include "ZEPDrwLockCombo.h"
#include "ZEPDrwLockComboColor.h"
#include "ZEPDrwLockComboDashed.h"
#include "ZEPDrwLockSpinner.h"
#include "ZEPDrwSettingsServices.h"

#include <climits>
#include <cmath>
#include <vector>

using S = ZEPDrwSettingsServices;

class ZEPDrwSettingsServicesTest : public ZEPHostTest {
protected:
  static ZEPUnicodeString LengthUnit(unsigned char iPaper, int iRange) {
    return S::GetLengthUnit(iPaper, static_cast<ZEPCkeScale>(iRange));
  }
  static ZEPUnicodeString AngleUnit() { return S::GetAngleUnit(); }
  static std::vector<std::string> Names(const ZEPListValZEPUnicodeString& iList) {
    std::vector<std::string> names;
    for (const ZEPUnicodeString& n : iList.Items()) names.push_back(n.str());
    return names;
  }
  static void SetPaperUnit(int iUnit) {
    ZEPSysSettingRepository::Open("DraftingOptions")->WriteAttr("DrwPaperLengthUnit", &iUnit, 1);
  }
  // The toolkit unit a length control receives.
  int LengthControlUnit(int iRange, unsigned char iPaper) {
    ZEPDlgSpinner spinner(&_root, "spn", 0x60000);
    S::SetLengthUnitToDlgControl(&spinner, static_cast<ZEPCkeScale>(iRange), iPaper, 3, 0);
    return spinner.GetUnit();
  }
  ZEPSettingInfo _info;
};

// Every GetValueFrom answers only for its own inner control and leaves the output alone
// otherwise; the value read back is the one the matching Update showed.
TEST_F(ZEPDrwSettingsServicesTest, ValueTransferAnswersOnlyTheInnerControl) {
  auto* other = new ZEPDrwLockCheckButton(&_root, "checkOther", _info);
  auto probe = [&](auto* iControl, auto iSentinel, auto iRead) {
    auto out = iSentinel;
    using C = decltype(iControl);
    for (ZEPCommand* sender :
         {static_cast<ZEPCommand*>(nullptr), static_cast<ZEPCommand*>(iControl),
          static_cast<ZEPCommand*>(iControl->GetLock()), static_cast<ZEPCommand*>(other->GetDialog())}) {
      EXPECT_EQ(E_FAIL, iRead(iControl, sender, out)) << iControl->GetOwnName();
      EXPECT_TRUE(out == iSentinel) << iControl->GetOwnName();
    }
    EXPECT_EQ(E_FAIL, iRead(static_cast<C>(nullptr), iControl->GetDialog(), out));
    EXPECT_EQ(S_OK, iRead(iControl, iControl->GetDialog(), out)) << iControl->GetOwnName();
    return out;
  };

  auto* check = new ZEPDrwLockCheckButton(&_root, "checkGrid", _info);
  auto readCheck = [](auto* c, ZEPCommand* s, unsigned char& o) { return S::GetValueFromCheckButton(c, s, o); };
  EXPECT_EQ(S_OK, S::UpdateCheckButton(check, 5));
  EXPECT_EQ(1, probe(check, static_cast<unsigned char>(77), readCheck));
  EXPECT_EQ(S_OK, S::UpdateCheckButton(check, 0));
  EXPECT_EQ(0, probe(check, static_cast<unsigned char>(77), readCheck));

  auto* combo = new ZEPDrwLockCombo(&_root, "cmbStyle", _info);
  for (const char* line : {"a", "b", "c"}) combo->SetLine(line);
  EXPECT_EQ(S_OK, S::UpdateCombo(combo, 2u));
  EXPECT_EQ(2, probe(combo, -7, [](auto* c, ZEPCommand* s, int& o) { return S::GetValueFromCombo(c, s, o); }));
  EXPECT_EQ(S_OK, S::UpdateCombo(combo, ZEPUnicodeString("b")));
  auto readText = [](auto* c, ZEPCommand* s, ZEPUnicodeString& o) { return S::GetValueFromCombo(c, s, o); };
  EXPECT_EQ("b", probe(combo, ZEPUnicodeString("none"), readText).str());

  // The break line is 0 in the settings and entry 8 of the combo, both ways.
  auto* lineType = new ZEPDrwLockComboDashed(&_root, "cmbLineType", _info, 1, 0, 1);
  auto readType = [](auto* c, ZEPCommand* s, int& o) { return S::GetValueFromLineType(c, s, o); };
  EXPECT_EQ(S_OK, S::UpdateComboLineType(lineType, 0u));
  EXPECT_EQ(8u, lineType->GetCombo()->GetSelect());
  EXPECT_EQ(0, probe(lineType, -7, readType));
  EXPECT_EQ(S_OK, S::UpdateComboLineType(lineType, 3u));
  EXPECT_EQ(3, probe(lineType, -7, readType));

  auto* spinner = new ZEPDrwLockSpinner(&_root, "spnLength", _info, 0x60000);
  EXPECT_EQ(S_OK, S::UpdateSpinner(spinner, 0.5));
  auto readMm = [](auto* c, ZEPCommand* s, double& o) { return S::GetValueFromSpinner(c, s, 1000.0, o); };
  EXPECT_DOUBLE_EQ(500.0, probe(spinner, -1.0, readMm));

  auto* colour = new ZEPDrwLockComboColor(&_root, "cmbColor", _info);
  EXPECT_EQ(S_OK, S::UpdateComboColor(colour, 255u, 128u, 0u));
  struct Rgb {
    int r, g, b;
    bool operator==(const Rgb& o) const { return r == o.r && g == o.g && b == o.b; }
  };
  auto readRgb = [](auto* c, ZEPCommand* s, Rgb& o) { return S::GetValueFromComboColor(c, s, o.r, o.g, o.b); };
  EXPECT_TRUE((Rgb{255, 128, 0}) == probe(colour, Rgb{-1, -1, -1}, readRgb));
  // Out of range components are refused in ints and unsigned ints; the combo keeps its colour.
  EXPECT_EQ(E_FAIL, S::UpdateComboColor(colour, 256, 0, 0));
  EXPECT_EQ(E_FAIL, S::UpdateComboColor(colour, -1, 0, 0));
  EXPECT_EQ(E_FAIL, S::UpdateComboColor(colour, 0u, 0u, 256u));
  EXPECT_TRUE((Rgb{255, 128, 0}) == probe(colour, Rgb{-1, -1, -1}, readRgb));

  EXPECT_EQ(0, ZEPCheckLog::Count());
}

// A page hears the user type in a count spinner; the value is truncated and shown back.
class CountPage : public ZEPDlgFrame {
public:
  explicit CountPage(ZEPDialog* iParent) : ZEPDlgFrame(iParent, "page") {
    ZEPSettingInfo info;
    _pSpinner = new ZEPDrwLockSpinner(this, "spnCount", info, 0x40000);
    AddAnalyseNotificationCB(_pSpinner->GetDialog(), _pSpinner->GetSpinnerModifyNotification(), &CountPage::Write,
                             nullptr);
  }
  void Write(ZEPCommand* iSender, ZEPNotification*, void*) {
    _status = ZEPDrwSettingsServices::GetValueFromSpinner(_pSpinner, iSender, _count);
  }
  ZEPDrwLockSpinner* _pSpinner;
  int _count = 99;
  long _status = 1;
};

TEST_F(ZEPDrwSettingsServicesTest, CountSpinnerTruncatesTowardZeroAndClampsToInt) {
  auto* page = new CountPage(&_root);
  ZEPDialog* field = ZEPDlgDriver::FindControl(page, "spnCount");
  const struct {
    double typed;
    int expected;
  } cases[] = {{-2.7, -2}, {2.7, 2}, {1e12, INT_MAX}, {-1e12, INT_MIN}};
  for (const auto& c : cases) {
    ASSERT_TRUE(ZEPDlgDriver::Enter(field, c.typed));
    EXPECT_EQ(S_OK, page->_status);
    EXPECT_EQ(c.expected, page->_count) << c.typed;
    EXPECT_EQ(static_cast<double>(c.expected), page->_pSpinner->GetValue()) << c.typed;
  }
}

TEST_F(ZEPDrwSettingsServicesTest, LimitsFollowRangePaperUnitAndRefuseCountSpinners) {
  ZEPDlgSpinner length(&_root, "spnLength", 0x60000);
  double mn = -1, mx = -1, step = -1;
  auto expectLimits = [&](double iMin, double iMax, double iStep) {
    length.GetMinMaxStep(mn, mx, step);
    EXPECT_DOUBLE_EQ(iMin, mn);
    EXPECT_DOUBLE_EQ(iMax, mx);
    EXPECT_DOUBLE_EQ(iStep, step);
  };
  S::SetLengthMinMaxStep(&length, ZEPCkeScaleExtraLarge, 0, 0.0, 100000.0, 5.0);
  expectLimits(0.0, 1000000.0, 0.005);
  S::SetLengthMinMaxStep(&length, ZEPCkeScaleExtraSmall, 0, 0.0, 100000.0, 5.0);
  expectLimits(0.0, 0.01, 0.005);
  SetPaperUnit(5);
  S::SetLengthMinMaxStep(&length, ZEPCkeScaleExtraLarge, 1, 0.0, 100000.0, 5.0);
  expectLimits(0.0, 100.0, 0.0005);

  const double pi = std::acos(-1.0);
  S::SetAngleMinMaxStep(&length, -180.0, 180.0, 5.0);
  expectLimits(-pi, pi, pi / 36);

  ZEPDlgSpinner count(&_root, "spnCount", 0x40000);
  count.SetRange(1.f, 9.f, 8);
  S::SetLengthMinMaxStep(&count, ZEPCkeScaleNormal, 0, 0.0, 100.0, 1.0);
  S::SetAngleMinMaxStep(&count, 0.0, 90.0, 1.0);
  count.GetMinMaxStep(mn, mx, step);
  EXPECT_EQ(1.0, mn);
  EXPECT_EQ(9.0, mx);
  EXPECT_EQ(2, ZEPCheckLog::Count());
  EXPECT_TRUE(ZEPCheckLog::Contains("iDlgSpinner->GetStyle()&ZEPDlgSpnDouble"));
  S::SetLengthMinMaxStep(nullptr, ZEPCkeScaleNormal, 0, 0.0, 1.0, 1.0);
  EXPECT_TRUE(ZEPCheckLog::Contains("iDlgSpinner"));
}

TEST_F(ZEPDrwSettingsServicesTest, PaperUnitComesFromTheRepository) {
  EXPECT_EQ(45, LengthControlUnit(1, 1));
  EXPECT_TRUE(ZEPCheckLog::Contains("pRep"));
  ZEPCheckLog::Clear();
  ZEPSysSettingRepository::Open("DraftingOptions");
  EXPECT_EQ(45, LengthControlUnit(1, 1)); // attribute missing
  const int expected[][2] = {{1, 45}, {2, 45}, {3, 46}, {5, 48}, {7, 45}};
  for (const auto& e : expected) {
    SetPaperUnit(e[0]);
    EXPECT_EQ(e[1], LengthControlUnit(2, 1)) << e[0];
  }
  EXPECT_EQ(0, ZEPCheckLog::Count());
}

TEST_F(ZEPDrwSettingsServicesTest, UserUnitsPerRangeAndTheirFallbacks) {
  ASSERT_TRUE(ZEPCkeUnitsSetup::SetLengthUnit(ZEPCkeScaleLarge, "METER"));
  ASSERT_TRUE(ZEPCkeUnitsSetup::SetLengthUnit(ZEPCkeScaleSmall, "FOOT"));
  EXPECT_EQ(45, LengthControlUnit(1, 0));
  EXPECT_EQ(43, LengthControlUnit(2, 0));
  EXPECT_EQ(49, LengthControlUnit(4, 0));
  EXPECT_EQ(0, ZEPCheckLog::Count());

  ZEPDlgSpinner angle(&_root, "spnAngle", 0x60000);
  const struct {
    const char* name;
    int unit;
  } angles[] = {{"RADIAN", 11}, {"GRADE", 15}, {"DEGREE", 12}, {"TURN", 12}};
  for (const auto& a : angles) {
    ASSERT_TRUE(ZEPCkeUnitsSetup::SetAngleUnit(a.name));
    S::SetAngleUnitToDlgControl(&angle, 0, 0);
    EXPECT_EQ(a.unit, angle.GetUnit()) << a.name;
  }
  EXPECT_EQ(0, ZEPCheckLog::Count());

  ZEPCkeUnitsSetup::SetLengthUnit(ZEPCkeScaleLarge, "MILE");
  EXPECT_EQ(45, LengthControlUnit(2, 0));
  EXPECT_TRUE(ZEPCheckLog::Contains("Not supported unit"));

  // Units the host would answer differ from the fallbacks, so a fallback shows.
  ZEPCkeUnitsSetup::SetLengthUnit("INCH");
  ZEPCkeUnitsSetup::SetAngleUnit("RADIAN");
  ZEPCkeUnitsSetup::SetLengthUnit(ZEPCkeScaleExtraLarge, "");
  EXPECT_EQ("INCH", LengthUnit(0, 1).str());
  EXPECT_EQ("MM", LengthUnit(0, 3).str());
  EXPECT_TRUE(ZEPCheckLog::Contains("spLengthUnit"));
  ZEPCkeUnitsSetup::SetUnitsAvailable(false);
  EXPECT_EQ("DEGREE", AngleUnit().str());
  EXPECT_TRUE(ZEPCheckLog::Contains("spAngleUnit"));
  ZEPCkeUnitsSetup::SetUnitsAvailable(true);
  ZEPCkeUnitsSetup::SetMagnitudesAvailable(false);
  EXPECT_EQ("MM", LengthUnit(0, 1).str());
  EXPECT_EQ("DEGREE", AngleUnit().str());
  EXPECT_TRUE(ZEPCheckLog::Contains("spLengthMagnitudeCke"));
  EXPECT_TRUE(ZEPCheckLog::Contains("spAngleMagnitudeCke"));

  ZEPCheckLog::Clear();
  S::SetLengthUnitToDlgControl(nullptr, ZEPCkeScaleNormal, 0, 3, 0);
  S::SetAngleUnitToDlgControl(nullptr, 3, 0);
  EXPECT_EQ(2, ZEPCheckLog::Count());
  EXPECT_TRUE(ZEPCheckLog::Contains("iDlgControl"));
}

TEST_F(ZEPDrwSettingsServicesTest, XmlFileNamesAreFilteredDedupedAndSorted) {
  ZEPListValZEPUnicodeString names;
  ZEPStdSetup::SetStandardFiles("drafting", {"ISO.xml", "ANSI.xml", "readme.txt", "ISO.XML"});
  EXPECT_EQ(S_OK, S::GetXmlFilesNames("drafting", 0, names));
  EXPECT_EQ((std::vector<std::string>{"ANSI", "ISO"}), Names(names));
  EXPECT_EQ(S_OK, S::GetXmlFilesNames("drafting", 1, names));
  EXPECT_EQ((std::vector<std::string>{"ANSI.xml", "ISO.XML", "ISO.xml"}), Names(names));

  ZEPStdSetup::SetStandardFiles("drafting", {"Норма.xml", ".xml", "xml", "€.x", "b.XmL", "a.xml.bak"});
  EXPECT_EQ(S_OK, S::GetXmlFilesNames("drafting", 0, names));
  EXPECT_EQ((std::vector<std::string>{"", "b", "Норма"}), Names(names));

  ZEPStdSetup::SetStandardFiles("drafting", {});
  EXPECT_EQ(S_OK, S::GetXmlFilesNames("drafting", 0, names));
  EXPECT_EQ(0, names.Size());

  names.Append("stale");
  ZEPStdSetup::SetNoList("drafting");
  EXPECT_EQ(E_FAIL, S::GetXmlFilesNames("drafting", 0, names));
  EXPECT_EQ(0, names.Size());

  // The container's own folder, and a type that would leave it.
  ZEPStdSetup::Reset();
  EXPECT_EQ(S_OK, S::GetXmlFilesNames("drafting", 0, names));
  EXPECT_EQ((std::vector<std::string>{"ANSI", "ISO", "JIS"}), Names(names));
  EXPECT_EQ(E_FAIL, S::GetXmlFilesNames("../catalogs", 1, names));
}
