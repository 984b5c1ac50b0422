// Host services of the main page: scale text and fractions, the combo list notifications and
// command fathers.
#include "TestSupport.h"

#include <cmath>
#include <limits>

namespace {
class HostScaleToolbox : public ZEPHostTest {};
class HostToolkitExtras : public ZEPHostTest {};
} // namespace

TEST_F(HostScaleToolbox, ScaleTextsAreReadAsRatiosOrNumbersAndGarbageIsRefused) {
  const struct {
    const char* text;
    double value;
    int form;
  } good[] = {{"1:50", 0.02, 1}, {" 1 / 50 ", 0.02, 2}, {"2", 2.0, 0}, {"0.5", 0.5, 0}, {"3:2", 1.5, 1}};
  for (const auto& g : good) {
    ZEPUnicodeString text;
    double value = 0.0;
    int form = -1;
    ASSERT_EQ(ZEPDfuScaleAndUnitsToolbox::ConvertScaleFromStringToDouble(g.text, text, value, form), S_OK) << g.text;
    EXPECT_DOUBLE_EQ(value, g.value) << g.text;
    EXPECT_EQ(form, g.form) << g.text;
  }
  for (const char* bad : {"", "abc", "1:", ":50", "1:0", "0", "-2", "1:-5", "1:2:3", "1:2/3", "inf", "nan", "0x10",
                          "1e400", "2 3", "1,5"}) {
    ZEPUnicodeString text("kept");
    double value = 7.0;
    int form = 9;
    EXPECT_EQ(ZEPDfuScaleAndUnitsToolbox::ConvertScaleFromStringToDouble(bad, text, value, form), E_FAIL) << bad;
    EXPECT_EQ(value, 7.0) << bad;
    EXPECT_EQ(text.str(), "kept") << bad;
  }
}

TEST_F(HostScaleToolbox, DecimalsBecomeTheSimplestCloseFraction) {
  const struct {
    double value, numerator, denominator;
  } cases[] = {{0.01, 1, 100}, {0.02, 1, 50},   {0.0001, 1, 10000}, {10000, 10000, 1},
               {0.75, 3, 4},   {1.0 / 3, 1, 3}, {-0.5, -1, 2},      {0, 0, 1}};
  for (const auto& c : cases) {
    double n = 1.0, d = 1.0;
    ASSERT_EQ(ZEPDfuScaleAndUnitsToolbox::DecimalToFractionConvertor(c.value, n, d, 6), S_OK) << c.value;
    EXPECT_EQ(n, c.numerator) << c.value;
    EXPECT_EQ(d, c.denominator) << c.value;
  }
  // Tiny ratios stay within the precision asked, relative to the value.
  double n = 0.0, d = 0.0;
  ASSERT_EQ(ZEPDfuScaleAndUnitsToolbox::DecimalToFractionConvertor(1.2345e-9, n, d, 6), S_OK);
  EXPECT_NEAR(n / d, 1.2345e-9, 1.2345e-15);
  for (double v : {std::numeric_limits<double>::infinity(), std::nan(""), 1e-15}) {
    double n = 1.0, d = 1.0;
    EXPECT_EQ(ZEPDfuScaleAndUnitsToolbox::DecimalToFractionConvertor(v, n, d, 6), E_FAIL) << v;
    EXPECT_EQ(n, 1.0);
  }
}

TEST_F(HostToolkitExtras, ListNotificationsAreTypedAndReachTheCombosSubscribers) {
  auto* combo = new ZEPDlgCombo(&_root, "combo");
  ZEPNotification* drop = combo->GetComboDropNotification();
  ZEPNotification* closeUp = combo->GetComboCloseUpNotification();
  EXPECT_NE(ZEPSysDynamicCast<ZEPDlgComboDropNotification>(drop), nullptr);
  EXPECT_EQ(ZEPSysDynamicCast<ZEPDlgComboCloseUpNotification>(drop), nullptr);
  EXPECT_NE(ZEPSysDynamicCast<ZEPDlgComboCloseUpNotification>(closeUp), nullptr);
  EXPECT_EQ(ZEPSysDynamicCast<ZEPDlgComboDropNotification>(combo->GetComboSelectNotification()), nullptr);

  combo->SetLine("plain");
  combo->SetLine("with icon", ZEPString("I_Icon"));
  ZEPString icon = "x";
  EXPECT_EQ(combo->GetLineIconName(icon, 1), 1);
  EXPECT_EQ(icon, "I_Icon");
  EXPECT_EQ(combo->GetLineIconName(icon, 0), 0);
  EXPECT_EQ(icon, "");
  EXPECT_EQ(combo->GetLineIconName(icon, 2), -1);

  combo->SetSensitivity(ZEPDlgDisable);
  EXPECT_FALSE(ZEPDlgDriver::DropDown(combo));
  EXPECT_FALSE(ZEPDlgDriver::CloseUp(combo));
  EXPECT_FALSE(ZEPDlgDriver::DropDown(&_root));
}

TEST_F(HostToolkitExtras, AFatherIsForgottenWhenItDiesAndNeverMadeACycle) {
  ZEPCommand command;
  {
    ZEPCommand father;
    command.SetFather(&father);
    EXPECT_EQ(command.GetFather(), &father);
    father.SetFather(&command); // would send round for ever: refused
    EXPECT_EQ(father.GetFather(), nullptr);
  }
  EXPECT_EQ(command.GetFather(), nullptr);
  command.SendNotification(command.OwnNotification("Any")); // reaches no dead father

  auto* widget = new ZEPDlgFrame(&_root, "frame");
  EXPECT_EQ(widget->GetFather(), &_root);
  command.SetFather(widget);
  widget->RequestDelayedDestruction();
  ZEPDlgDriver::Idle();
  EXPECT_EQ(command.GetFather(), nullptr);
}

// A chooser offers the repository's standards once asked for the drafting standard type.
TEST_F(HostToolkitExtras, TheChooserListsTheRepositoryForTheStandardTypeOnly) {
  ZEPPLMSetup::SetRepository({{"Company", "K-1"}, {"Company", "K-2", -1}});
  ZEPIPLMChooserFactory* factory = nullptr;
  ASSERT_EQ(ZEPPLMUIBasicServices::GetPLMChooserFactory(factory), S_OK);
  ZEPIPLMChooser* chooser = nullptr;
  factory->CreatePLMChooser(&_root, "chooser", chooser);
  factory->Release();
  ASSERT_NE(chooser, nullptr);
  EXPECT_TRUE(ZEPPLMSetup::Listed(chooser).empty());
  ZEPIType_var type;
  ZEPCkeTypeProtectedServices::RetrieveKnowledgeType("DIFStandardRep", type);
  ZEPListValZEPIType_var types;
  types.Append(type);
  chooser->SetTypes(types);
  const std::vector<ZEPPLMSetup::Standard> listed = ZEPPLMSetup::Listed(chooser);
  ASSERT_EQ(listed.size(), 2u);
  EXPECT_EQ(listed[1].key, "K-2");
  EXPECT_EQ(listed[1].unicity, -1);
  chooser->Release();
  ZEPPLMSetup::Reset();
  EXPECT_TRUE(ZEPPLMSetup::Repository().empty());
}
