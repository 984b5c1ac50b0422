// The host stand-in: notifications, radio groups, delayed destruction, lists, repositories.
#include "TestSupport.h"

#include <algorithm>
#include <random>

namespace {
int Descending(int* a, int* b) { return *a < *b ? 1 : -1; }           // never 0
int AlwaysGreater(int*, int*) { return 1; }                           // inconsistent
int AlwaysLess(int*, int*) { return -1; }                             // inconsistent
int NameOrder(ZEPUnicodeString* a, ZEPUnicodeString* b) { return *a > *b ? 1 : -1; }
} // namespace

using HostToolkit = ZEPHostTest;

TEST_F(HostToolkit, RadioGroupsTurnOneOffThenNotifyBoth) {
  auto* group = new ZEPDlgFrame(&_root, "grpCapping", 0x80001);
  auto* fix = new ZEPDlgRadioButton(group, "radCappingColorFix");
  auto* face = new ZEPDlgRadioButton(group, "radCappingColorFromFace");
  auto* other = new ZEPDlgFrame(&_root, "grpOther", 0x80001);
  auto* elsewhere = new ZEPDlgRadioButton(other, "radElsewhere");
  elsewhere->SetState(ZEPDlgChecked);
  fix->SetState(ZEPDlgChecked, 1); // programmatic: no notification
  NotificationRecorder rec(&_root);
  for (auto* r : {fix, face, elsewhere}) rec.Listen(r, r->GetRadBModifyNotification());

  EXPECT_TRUE(ZEPDlgDriver::Click(face));
  EXPECT_EQ(fix->GetState(), ZEPDlgUnchecked);
  EXPECT_EQ(face->GetState(), ZEPDlgChecked);
  EXPECT_EQ(elsewhere->GetState(), ZEPDlgChecked); // another frame is another group
  EXPECT_EQ(rec._events, (std::vector<std::string>{"radCappingColorFix:RadBModify=off",
                                                   "radCappingColorFromFace:RadBModify=on"}));
  // Clicking the selected radio changes nothing and tells nobody.
  EXPECT_TRUE(ZEPDlgDriver::Click(face));
  EXPECT_EQ(rec._events.size(), 2u);
  // A disabled group refuses the click.
  group->SetSensitivity(ZEPDlgDisable);
  EXPECT_FALSE(ZEPDlgDriver::Click(fix));
  EXPECT_EQ(fix->GetState(), ZEPDlgUnchecked);
}

TEST_F(HostToolkit, NotificationsRiseToTheRegisteredSenderAndSkipTheDead) {
  auto* colour = new ZEPComboColor(&_root, "cmbColor", 0, 255, 255, 255, 0, 0, 0);
  auto* rec = new NotificationRecorder(&_root);
  // Registered on the application combo for its inner combo's notification.
  rec->Listen(colour, colour->GetCombo()->GetComboSelectNotification());
  EXPECT_TRUE(ZEPDlgDriver::SelectColor(colour, 1, 2, 3));
  ASSERT_EQ(rec->_events.size(), 1u);
  EXPECT_EQ(rec->_events[0], "cmbColor:ComboSelect");
  unsigned int r = 0, g = 0, b = 0;
  colour->GetSelectedColor(&r, &g, &b);
  EXPECT_EQ(b, 3u);
  EXPECT_FALSE(ZEPDlgDriver::SelectColor(colour, 256, 0, 0));

  // A destroyed subscriber is never called, even by a sender that outlives it.
  delete rec;
  EXPECT_TRUE(ZEPDlgDriver::Select(colour, 2));
  auto* again = new NotificationRecorder(&_root);
  EXPECT_TRUE(ZEPDlgDriver::Select(colour, 3));
  EXPECT_TRUE(again->_events.empty());
}

TEST_F(HostToolkit, DelayedDestructionAndTreeOwnership) {
  auto* dialog = new ZEPDlgDialog(&_root, "dlgAssoc3D", 0x11440201);
  auto* inner = new ZEPDlgCheckButton(dialog, "chkInner");
  EXPECT_EQ(dialog->GetVisibility(), ZEPDlgHide);
  EXPECT_FALSE(ZEPDlgDriver::Click(inner)); // not shown yet
  dialog->SetVisibility(ZEPDlgShow);
  EXPECT_TRUE(ZEPDlgDriver::Click(inner));
  dialog->RequestDelayedDestruction();
  dialog->RequestDelayedDestruction();
  EXPECT_EQ(ZEPDlgDriver::Find(&_root, "chkInner"), inner);
  ZEPDlgDriver::Idle();
  EXPECT_EQ(ZEPDlgDriver::Find(&_root, "dlgAssoc3D"), nullptr);
  // A widget queued for destruction and destroyed with its parent first is not destroyed twice.
  auto* parent = new ZEPDlgFrame(&_root, "parent");
  auto* child = new ZEPDlgDialog(parent, "child");
  child->RequestDelayedDestruction();
  delete parent;
  ZEPDlgDriver::Idle();
  EXPECT_TRUE(_root.GetChildren().empty());
}

TEST_F(HostToolkit, DynamicCastFollowsTheClassTree) {
  ZEPDlgSpinner spinner(&_root, "spn", 0x60000);
  EXPECT_EQ(ZEPSysDynamicCast(ZEPDlgControl::MetaObject(), &spinner), &spinner);
  EXPECT_EQ(ZEPSysDynamicCast<ZEPDlgCombo>(&spinner), nullptr);
  EXPECT_EQ(ZEPSysDynamicCast<ZEPDlgSpinner>(static_cast<ZEPBaseUnknown*>(nullptr)), nullptr);
  EXPECT_TRUE(spinner.IsAKindOf("ZEPDialog"));
  EXPECT_FALSE(spinner.IsAKindOf("ZEPDlgEditor"));
  EXPECT_STREQ(spinner.IsA(), "ZEPDlgSpinner");
}

TEST_F(HostToolkit, QuickSortStaysInBoundsWithComparatorsThatNeverAnswerZero) {
  std::mt19937 rng(7);
  for (int n : {0, 1, 2, 3, 17, 200}) {
    std::vector<int> values(static_cast<size_t>(n));
    for (int& v : values) v = static_cast<int>(rng() % 5); // many equal values
    ZEPRawCollint list;
    for (int v : values) list.Append(v);
    list.QuickSort(Descending);
    std::sort(values.begin(), values.end(), std::greater<int>());
    EXPECT_EQ(list.Items(), values) << "n=" << n;
    // Comparators that are no ordering at all must still end with the same elements.
    for (auto cmp : {AlwaysGreater, AlwaysLess}) {
      ZEPRawCollint other;
      for (int v : values) other.Append(v);
      other.QuickSort(cmp);
      std::vector<int> got = other.Items();
      std::sort(got.begin(), got.end(), std::greater<int>());
      EXPECT_EQ(got, values);
    }
  }
  ZEPListValZEPUnicodeString names;
  for (const char* s : {"ISO", "ANSI", "ISO", "JIS", "ANSI"}) names.Append(s);
  names.RemoveDuplicates();
  names.QuickSort(NameOrder);
  ASSERT_EQ(names.Size(), 3);
  EXPECT_EQ(names[1].str(), "ANSI");
  EXPECT_EQ(names[3].str(), "JIS");
  EXPECT_EQ(names.Locate("JIS"), 3);
  EXPECT_EQ(names.Locate("ANSI", 2), 0);
  names.RemovePosition(0);
  names.RemovePosition(9);
  names.RemovePosition(1);
  EXPECT_EQ(names[1].str(), "ISO");
  EXPECT_EQ(names[7].str(), ""); // out of range reads give the empty value
  names.RemoveAll(1);
  EXPECT_EQ(names.Size(), 0);
}

TEST_F(HostToolkit, UnicodeStringCountsCharacters) {
  ZEPUnicodeString s("Norme-é.XML");
  EXPECT_EQ(s.GetLengthInChar(), 11);
  EXPECT_EQ(s.SubString(7, 4).ToLower().str(), ".xml");
  s.RemoveTail(4);
  EXPECT_EQ(s.str(), "Norme-é");
  EXPECT_EQ(ZEPUnicodeString("ab").SubString(1, 10).str(), "b");
  EXPECT_EQ(ZEPUnicodeString("ab").SubString(5, 1).str(), "");
}

TEST_F(HostToolkit, RepositoryReadsKeepDefaultsAndLocksRefuseWrites) {
  EXPECT_EQ(ZEPSysSettingRepository::GetRepository("DraftingOptions", 0), nullptr);
  ZEPSysSettingRepository* rep = ZEPSysSettingRepository::Open("DraftingOptions");
  EXPECT_EQ(ZEPSysSettingRepository::GetRepository("DraftingOptions", 0), rep);

  double spacing[5] = {1, 2, 3, 4, 5};
  double written[2] = {10.0, 20.0};
  EXPECT_EQ(rep->WriteAttr("Spacing", written, 2), 1);
  EXPECT_EQ(rep->ReadAttr("Spacing", spacing, 5), 2);
  EXPECT_EQ(spacing[1], 20.0);
  EXPECT_EQ(spacing[2], 3.0); // fewer read: the caller's default stays
  int asInt = 42;
  EXPECT_EQ(rep->ReadAttr("Spacing", &asInt, 1), 0); // another type reads nothing
  EXPECT_EQ(asInt, 42);
  double nan = std::nan("");
  EXPECT_EQ(rep->WriteAttr("Spacing", &nan, 1), 0);

  // Texts: a list may be empty; text read from numbers reads nothing; bad UTF-8 and NUL refused.
  std::vector<std::string> texts{"keep"};
  EXPECT_EQ(rep->ReadAttr("Spacing", texts), -1);
  EXPECT_EQ(texts, std::vector<std::string>{"keep"});
  EXPECT_EQ(rep->WriteAttr("Standards", std::vector<std::string>{}), 1);
  EXPECT_EQ(rep->ReadAttr("Standards", texts), 0);
  EXPECT_TRUE(texts.empty());
  EXPECT_EQ(rep->WriteAttr("Standards", std::vector<std::string>{"ISO", "Entreprise \xc3\xa9"}), 1);
  EXPECT_EQ(rep->WriteAttr("Standards", std::vector<std::string>{"ok", "bad \xc3"}), 0);
  EXPECT_EQ(rep->WriteAttr("Standards", std::vector<std::string>{std::string("a\0b", 3)}), 0);
  EXPECT_EQ(rep->ReadAttr("Standards", texts), 2);
  EXPECT_EQ(texts[1], "Entreprise \xc3\xa9");
  EXPECT_EQ(rep->ReadAttr("Standards", spacing, 5), 0);

  int unit = 5;
  rep->SetDefault("DrwPaperLengthUnit", std::vector<int>{3});
  int read = 0;
  EXPECT_EQ(rep->ReadAttr("DrwPaperLengthUnit", &read, 1), 1);
  EXPECT_EQ(read, 3); // a default is not a lock
  EXPECT_EQ(rep->WriteAttr("DrwPaperLengthUnit", &unit, 1), 1);
  rep->ReadAttr("DrwPaperLengthUnit", &read, 1);
  EXPECT_EQ(read, 5);
  rep->SetLock("DrwPaperLengthUnit", true, "admin");
  rep->ReadAttr("DrwPaperLengthUnit", &read, 1);
  EXPECT_EQ(read, 3); // locked: the administrator's value
  EXPECT_EQ(rep->WriteAttr("DrwPaperLengthUnit", &unit, 1), 0);
  ZEPSettingInfo info;
  rep->GetLockInfo("DrwPaperLengthUnit", info);
  EXPECT_TRUE(info.IsLocked());
  EXPECT_EQ(info.GetLockText(), "admin");

  // Saving reaches the handler once per change.
  int saves = 0;
  rep->SetSaveHandler([&saves](ZEPSysSettingRepository&) { return ++saves == 1 ? E_FAIL : S_OK; });
  EXPECT_LT(rep->SaveRepository(), 0);
  EXPECT_EQ(rep->SaveRepository(), S_OK);
  EXPECT_EQ(rep->SaveRepository(), S_OK);
  EXPECT_EQ(saves, 2);
}

TEST_F(HostToolkit, ValuesOfAnySizeAreShownWhole) {
  ZEPDlgSpinner spinner(&_root, "spn", 0x60000);
  spinner.SetUnit(45); // millimetres
  spinner.SetPrecision(3);
  EXPECT_EQ(spinner.FormatValue(0.0125), "12.5 mm");
  EXPECT_EQ(spinner.FormatValue(-0.0000001), "0 mm");
  EXPECT_EQ(spinner.FormatValue(1e305), "1e+308 mm"); // not 64 bytes of made-up digits
  EXPECT_EQ(spinner.FormatValue(123456789012.345), "123456789012345 mm");
  spinner.SetPrecision(0);
  EXPECT_EQ(spinner.FormatValue(0.5), "500 mm");
}

TEST_F(HostToolkit, ColourComboSelectionReachesItsOwnSubscribers) {
  // A page subscribes on the colour combo itself, which is what the value transfer compares with.
  struct Listener : ZEPCommand {
    ZEPCommand* sender = nullptr;
    void Listen(ZEPComboColor* c) {
      AddCallback(c, c->GetComboSelectNotification(), [this](ZEPCommand* s, ZEPNotification*, void*) { sender = s; },
                  nullptr);
    }
  } listener;
  auto* colour = new ZEPComboColor(&_root, "colour", 0, 1, 2, 3, 0, 0, 0);
  listener.Listen(colour);
  ASSERT_TRUE(ZEPDlgDriver::SelectColor(colour, 10, 20, 30));
  EXPECT_EQ(listener.sender, colour);
}
