// Lock-aware controls: names, padlock-first sensitivity, text forwarding, fallbacks.
#include "TestSupport.h"

#include "ZEPDrwLockCheckButton.h"
#include "ZEPDrwLockCombo.h"
#include "ZEPDrwLockComboColor.h"
#include "ZEPDrwLockComboDashed.h"
#include "ZEPDrwLockComboSymbol.h"
#include "ZEPDrwLockComboWeight.h"
#include "ZEPDrwLockControl.h"
#include "ZEPDrwLockEditor.h"
#include "ZEPDrwLockFrame.h"
#include "ZEPDrwLockIconBox.h"
#include "ZEPDrwLockLabel.h"
#include "ZEPDrwLockPushButton.h"
#include "ZEPDrwLockSlider.h"
#include "ZEPDrwLockSpinner.h"

#include <filesystem>

namespace {
ZEPSettingInfo Locked() {
  ZEPSettingInfo info;
  info.SetLocked(true);
  info.SetLockText("admin in /etc/drafting/admin.json");
  return info;
}

// A control whose inner control went away: every operation takes its fallback.
template <class Base> struct Hollow : Base {
  template <class... A> explicit Hollow(A&&... a) : Base(std::forward<A>(a)...) { this->_pDialog = nullptr; }
};

// A control whose inner control is of the wrong class.
template <class Base> struct Mismatched : Base {
  template <class... A> explicit Mismatched(A&&... a) : Base(std::forward<A>(a)...) {
    this->_pDialog = new ZEPDlgLabel(this, "wrong", 0);
  }
};
} // namespace

using LockControls = ZEPHostTest;

TEST_F(LockControls, NamesCellsAndInnerControl) {
  ZEPSettingInfo info;
  auto* check = new ZEPDrwLockCheckButton(&_root, "checkGrid", info, 0);
  ASSERT_NE(check->GetDialog(), nullptr);
  // The names and cells of padlock and inner control are in the dump below.
  EXPECT_EQ(check->GetName(), "checkGrid_dialog");

  auto* frame = new ZEPDrwLockFrame(&_root, "frameGroup", info, 0x80001);
  EXPECT_EQ(frame->GetDialog()->GetOwnName(), "frameGrouplocked");
  EXPECT_EQ(frame->GetName(), "frameGrouplocked");

  // Without an inner control the frame answers its own name.
  auto* bare = new ZEPDrwLockControl(&_root, "bare", info);
  EXPECT_EQ(bare->GetDialog(), nullptr);
  EXPECT_EQ(bare->GetName(), "bare");
}

TEST_F(LockControls, PadlockDecidesSensitivity) {
  ZEPSettingInfo open;
  auto* free = new ZEPDrwLockSpinner(&_root, "spnFree", open, 0x60000);
  auto* locked = new ZEPDrwLockSpinner(&_root, "spnLocked", Locked(), 0x60000);

  // A locked setting's control is disabled at construction and stays so.
  EXPECT_EQ(locked->GetDialog()->GetSensitivity(), ZEPDlgDisable);
  locked->SetSensitivity(ZEPDlgEnable);
  EXPECT_EQ(locked->GetDialog()->GetSensitivity(), ZEPDlgDisable);
  EXPECT_EQ(locked->GetSensitivity(), ZEPDlgDisable);
  // Even a direct request on the inner widget does not get past the padlock.
  locked->GetDialog()->SetSensitivity(ZEPDlgEnable);
  EXPECT_FALSE(locked->GetDialog()->IsEffectivelyEnabled());
  // The frame itself stays sensitive: only the inner control is governed.
  EXPECT_EQ(locked->ZEPDlgFrame::GetSensitivity(), ZEPDlgEnable);

  free->SetSensitivity(ZEPDlgDisable);
  EXPECT_EQ(free->GetSensitivity(), ZEPDlgDisable);
  free->SetSensitivity(ZEPDlgEnable);
  EXPECT_EQ(free->GetSensitivity(), ZEPDlgEnable);

  // The user can operate the free control only.
  NotificationRecorder listener(&_root); // what a page would hear
  listener.Listen(free->GetDialog(), free->GetSpinnerModifyNotification());
  listener.Listen(locked->GetDialog(), locked->GetSpinnerModifyNotification());
  EXPECT_FALSE(ZEPDlgDriver::Enter(locked->GetDialog(), 0.5));
  EXPECT_EQ(locked->GetValue(), 0.0);
  EXPECT_TRUE(listener._events.empty());
  EXPECT_EQ(ZEPDlgDriver::WhyNotOperable(locked->GetDialog()), "locked by admin in /etc/drafting/admin.json");
  EXPECT_TRUE(ZEPDlgDriver::Enter(free->GetDialog(), 0.5));
  EXPECT_EQ(free->GetValue(), 0.5);
  EXPECT_EQ(listener._events.size(), 1u);
  EXPECT_EQ(listener._pLastSender, free->GetDialog());

  // Without padlock or inner control the sensitivity reads 16.
  Hollow<ZEPDrwLockCheckButton> hollow(&_root, "hollow", open, 0);
  EXPECT_EQ(hollow.GetSensitivity(), ZEPDlgDisable);
}

TEST_F(LockControls, LockFrameCoversEveryControlInside) {
  auto* group = new ZEPDrwLockFrame(&_root, "frameGuarded", Locked(), 0x80001);
  ZEPSettingInfo open;
  auto* inside = new ZEPDrwLockCheckButton(group->GetDialog(), "chkInside", open, 0);
  auto* push = new ZEPDlgPushButton(group->GetDialog(), "pushInside", 0);
  inside->SetSensitivity(ZEPDlgEnable);
  EXPECT_EQ(inside->GetSensitivity(), ZEPDlgEnable); // its own padlock is open...
  EXPECT_FALSE(ZEPDlgDriver::Click(inside->GetDialog())); // ...but the group's is closed
  EXPECT_FALSE(ZEPDlgDriver::Click(push));
  EXPECT_EQ(inside->GetState(), ZEPDlgUnchecked);
  EXPECT_EQ(ZEPDlgDriver::WhyNotOperable(push), "locked by admin in /etc/drafting/admin.json");

  // Unlocking gives the group back to the user.
  group->GetLock()->SetLocked(false);
  EXPECT_TRUE(ZEPDlgDriver::Click(inside->GetDialog()));
  EXPECT_EQ(inside->GetState(), ZEPDlgChecked);
}

TEST_F(LockControls, TextsGoWhereTheyBelong) {
  ZEPSettingInfo info;
  auto* combo = new ZEPDrwLockCombo(&_root, "cmbUnit", info);
  combo->SetTitle("Unit");
  EXPECT_EQ(combo->GetDialog()->GetTitle().str(), "Unit");
  EXPECT_TRUE(combo->GetLock()->GetTitle().IsEmpty());
  EXPECT_TRUE(combo->ZEPDlgFrame::GetTitle().IsEmpty());
  EXPECT_EQ(combo->GetTitle().str(), "Unit");
  combo->SetLongHelp("Unit of paper lengths");
  EXPECT_EQ(combo->GetLock()->GetLongHelp().str(), "Unit of paper lengths");
  EXPECT_EQ(combo->GetDialog()->GetLongHelp().str(), "Unit of paper lengths");
  combo->SetIconName("I_Unit");
  EXPECT_EQ(combo->GetDialog()->GetIconName(), "I_Unit");

  auto* bare = new ZEPDrwLockControl(&_root, "bare", info);
  bare->SetTitle("ignored");
  bare->ZEPDlgFrame::SetTitle("own");
  EXPECT_EQ(bare->GetTitle().str(), "own");

  // A label with text forwards to its text; without text it only fills a padlock column.
  auto* withText = new ZEPDrwLockLabel(&_root, "labelH", 1);
  withText->SetTitle("Horizontal");
  ASSERT_NE(withText->GetLabel(), nullptr);
  EXPECT_EQ(withText->GetLabel()->GetTitle().str(), "Horizontal");
  EXPECT_EQ(withText->GetLabel()->GetGridConstraints().column, 1);
  auto* spacer = new ZEPDrwLockLabel(&_root, "invLbl", 0);
  EXPECT_EQ(spacer->GetLabel(), nullptr);
  spacer->ZEPDlgFrame::SetTitle("frame title");
  spacer->SetTitle("dropped");
  EXPECT_EQ(spacer->GetTitle().str(), "frame title");
  EXPECT_EQ(spacer->GetName(), "invLbl");
  ZEPDialog* placeholder = spacer->GetChildren().at(0);
  EXPECT_EQ(placeholder->GetVisibility(), ZEPDlgHide);
  EXPECT_EQ(placeholder->GetIconName(), "CheckLock");
  EXPECT_EQ(placeholder->GetOwnName(), "invLbl");
}

TEST_F(LockControls, LineTypeTranslation) {
  ZEPSettingInfo info;
  auto* dashed = new ZEPDrwLockComboDashed(&_root, "cmbLineType", info, 1, 0, 1);
  dashed->SetSelect(0);
  EXPECT_EQ(dashed->GetCombo()->GetSelect(), 8u);
  EXPECT_EQ(dashed->GetSelect(), 0u);
  dashed->SetSelect(3);
  EXPECT_EQ(dashed->GetCombo()->GetSelect(), 3u);
  EXPECT_EQ(dashed->GetSelect(), 3u);
  // Picking the break line entry as a user reads back as 0.
  EXPECT_TRUE(ZEPDlgDriver::Select(dashed->GetDialog(), 7));
  EXPECT_EQ(dashed->GetSelect(), 0u);

  // Without the break line there is no entry 8 to select.
  auto* plain = new ZEPDrwLockComboDashed(&_root, "cmbPlain", info, 0, 0, 2);
  plain->SetSelect(0);
  EXPECT_EQ(plain->GetSelect(), 2u);
}

TEST_F(LockControls, FallbacksAndCheckTexts) {
  ZEPSettingInfo info;
  ZEPDrwLockControl bare(&_root, "bare", info);
  EXPECT_EQ(bare.GetMagnitude(), 11);
  EXPECT_EQ(bare.GetUnit(), 45);
  EXPECT_EQ(bare.GetPrecision(), 1);
  // A check button is no value control: the fallbacks hold as well.
  ZEPDrwLockCheckButton check(&_root, "chk", info, 0);
  check.SetUnit(48);
  EXPECT_EQ(check.GetUnit(), 45);
  // A spinner is one: unit and precision reach it.
  ZEPDrwLockSpinner spinner(&_root, "spn", info, 0x60000);
  spinner.SetUnit(48);
  spinner.SetPrecision(3);
  EXPECT_EQ(spinner.GetUnit(), 48);
  EXPECT_EQ(spinner.GetPrecision(), 3);

  Hollow<ZEPDrwLockComboWeight> weight(&_root, "weight", info, 0u, 1u);
  EXPECT_EQ(weight.GetSelect(), 1u);
  Hollow<ZEPDrwLockComboDashed> dashed(&_root, "dashed", info, 1, 0u, 1u);
  EXPECT_EQ(dashed.GetSelect(), 0u);
  Hollow<ZEPDrwLockComboSymbol> symbol(&_root, "symbol", info, 0u);
  EXPECT_EQ(symbol.GetSelect(), 0u);
  Hollow<ZEPDrwLockSpinner> hollowSpinner(&_root, "spin", info, 0x60000u);
  EXPECT_EQ(hollowSpinner.GetValue(), 0.0);
  EXPECT_EQ(hollowSpinner.GetFormat(), nullptr);
  EXPECT_EQ(hollowSpinner.GetSpinnerModifyNotification(), nullptr);
  Hollow<ZEPDrwLockSlider> slider(&_root, "slider", info, 0u);
  EXPECT_EQ(slider.SetCurrentValue(3.f, 0), 0.f);
  Hollow<ZEPDrwLockComboColor> colour(&_root, "colour", info);
  unsigned int r = 7, g = 7, b = 7;
  EXPECT_EQ(colour.GetSelectedColor(&r, &g, &b), 0);
  EXPECT_EQ(r + g + b, 21u);
  EXPECT_EQ(ZEPCheckLog::Count(), 0);

  Hollow<ZEPDrwLockIconBox> box(&_root, "box", info, 0u);
  EXPECT_EQ(box.GetSelect(), -1);
  EXPECT_EQ(box.SetSelect(2, 0), -1);
  EXPECT_TRUE(ZEPCheckLog::Contains("pIcb"));
  Mismatched<ZEPDrwLockCombo> combo(&_root, "combo", info, 0x40000u);
  EXPECT_EQ(combo.GetCombo(), nullptr);
  EXPECT_EQ(combo.SetLine("x"), -1);
  EXPECT_TRUE(ZEPCheckLog::Contains("pDlgCmb"));
  Mismatched<ZEPDrwLockPushButton> push(&_root, "push", info);
  EXPECT_EQ(push.GetPushBActivateNotification(), nullptr);
  EXPECT_TRUE(ZEPCheckLog::Contains("pPush"));
  EXPECT_EQ(ZEPCheckLog::Entries().back().path, "DraftingBaseSettings/ZEPDbsBaseSettings.m/src/ZEPDrwLockPushButton");
}

TEST_F(LockControls, PassThroughValues) {
  ZEPSettingInfo info;
  auto* combo = new ZEPDrwLockCombo(&_root, "cmb", info);
  EXPECT_EQ(combo->SetLine("Millimetre"), 0);
  EXPECT_EQ(combo->SetLine("Inch", "I_Inch"), 1);
  EXPECT_EQ(combo->SetSelect("Inch", 0), 1);
  EXPECT_EQ(combo->SetSelect("Parsec", 0), -1);
  EXPECT_EQ(combo->GetCombo()->GetSelect(), 1);

  auto* spinner = new ZEPDrwLockSpinner(&_root, "spn", info, 0x40000);
  spinner->SetRange(1.f, 100000.f, 99999);
  EXPECT_EQ(spinner->GetSpinner()->GetRangeFlag(), 1);
  spinner->SetRange(0.f, 10.f, 0.5f);
  EXPECT_EQ(spinner->GetSpinner()->GetRangeFlag(), 0);
  float mn = 0, mx = 0, step = 0;
  spinner->GetRange(mn, mx, step);
  EXPECT_EQ(mx, 10.f);
  EXPECT_EQ(step, 0.5f);

  auto* colour = new ZEPDrwLockComboColor(&_root, "cmbColor", info);
  unsigned int r = 0, g = 0, b = 0;
  EXPECT_EQ(colour->GetSelectedColor(&r, &g, &b), 1);
  EXPECT_EQ(r + g + b, 765u); // starts white
  colour->SetSelectedColor(67, 102, 85);
  ZEPUnicodeString name;
  EXPECT_EQ(colour->GetSelectedColor(&r, &g, &b, &name), 0);
  EXPECT_EQ(g, 102u);
  EXPECT_EQ(name.str(), "RGB 67,102,85");
}

TEST_F(LockControls, CatalogTextsReachNewControls) {
  // A page whose catalog holds texts for its controls.
  struct Page : ZEPDlgFrame {
    using ZEPDlgFrame::ZEPDlgFrame;
    ZEPString GetResourceFilename(int iIndex) const override {
      return iIndex >= 1 ? ZEPDlgFrame::GetResourceFilename(iIndex - 1) : "ZEPTestCatalogPage";
    }
  };
  const std::string dir = ::testing::TempDir() + "zep_catalogs";
  std::filesystem::create_directories(dir + "/catalogs");
  std::ofstream(dir + "/catalogs/ZEPTestCatalogPage.msg")
      << "# test catalog\n"
         "checkGrid.Title = \"Display the grid\";\n"
         "checkGrid.LongHelp = \"Shows the grid in \\\"sheet\\\" views\";\n"
         "labelH.Title = \"Horizontal\";\n";
  setenv("ZEP_RESOURCES", dir.c_str(), 1);
  ZEPMsgCatalog::Reset();

  Page page(&_root, "page", 0x80001);
  ZEPSettingInfo info;
  auto* section = new ZEPDlgToolsOptionsFrame(&page, "frameGrid", "I_DisplayGrid", 4);
  auto* check = new ZEPDrwLockCheckButton(section->GetOptionsFrame(), "checkGrid", info, 0);
  auto* label = new ZEPDrwLockLabel(section->GetOptionsFrame(), "labelH", 1);
  EXPECT_EQ(check->GetTitle().str(), "Display the grid");
  EXPECT_EQ(check->GetLock()->GetLongHelp().str(), "Shows the grid in \"sheet\" views");
  EXPECT_EQ(label->GetTitle().str(), "Horizontal");
  EXPECT_EQ(ZEPMsgCatalog::BuildMessage("ZEPTestCatalogPage", "labelH.Title").str(), "Horizontal");
  EXPECT_EQ(ZEPMsgCatalog::BuildMessage("ZEPTestCatalogPage", "missing", nullptr, 0, "fallback").str(), "fallback");
  // A catalog name that would leave the folder is never opened.
  EXPECT_EQ(ZEPMsgCatalog::BuildMessage("../catalogs/ZEPTestCatalogPage", "labelH.Title").str(), "");

  unsetenv("ZEP_RESOURCES");
  ZEPMsgCatalog::Reset();
}

TEST_F(LockControls, DumpOfEveryControl) {
  ZEPSettingInfo info;
  auto* frame = new ZEPDlgFrame(&_root, "frameAll", 0x80001);
  int row = 0;
  auto place = [&row](ZEPDialog* w) { w->SetGridConstraints(static_cast<short>(row++), 0, 1, 1, 0x1E); };
  place(new ZEPDrwLockLabel(frame, "lblCaption", 1));
  place(new ZEPDrwLockCheckButton(frame, "checkGrid", info, 0));
  auto* combo = new ZEPDrwLockCombo(frame, "cmbPaperLengthUnit", info);
  combo->SetLine("Millimetre");
  combo->SetLine("Inch");
  combo->SetSelect("Inch", 0);
  place(combo);
  place(new ZEPDrwLockComboColor(frame, "cmbSmartPick", info));
  place(new ZEPDrwLockComboDashed(frame, "cmbLineType", info, 1, 0, 2));
  place(new ZEPDrwLockComboSymbol(frame, "cmbSymbol", info, 0));
  place(new ZEPDrwLockComboWeight(frame, "cmbWeight", info, 0, 3));
  auto* editor = new ZEPDrwLockEditor(frame, "FrameAndTitleBlockPath", info, 0);
  editor->GetEditor()->SetText("/standards/frames", 0);
  place(editor);
  place(new ZEPDrwLockIconBox(frame, "icbAnchor", info, 0));
  place(new ZEPDrwLockPushButton(frame, "pushAssoc3D", info));
  place(new ZEPDrwLockSlider(frame, "sldTransparency", info, 0));
  auto* spinner = new ZEPDrwLockSpinner(frame, "editorGridSpacing", Locked(), 0x60000);
  spinner->SetUnit(45);
  spinner->SetPrecision(3);
  spinner->SetMinMaxStep(0.0, 100.0, 0.005);
  spinner->SetValue(0.1, 0);
  place(spinner);
  auto* guarded = new ZEPDrwLockFrame(frame, "frameGuarded", Locked(), 0x80001);
  new ZEPDrwLockCheckButton(guarded->GetDialog(), "chkGuarded", info, 0);
  place(guarded);
  ExpectGolden("lock_controls.dump", ZEPDlgDriver::Dump(frame));
}
