// Main page: the standard combo with folder and PLM standards, the PLM chooser, the optional
// parts and the scale ratio per range, operated through the driver as the user does.
#include "RecordingPages.h"

#include <algorithm>

namespace {
using Strings = std::vector<std::string>;

class MainPage : public PageTest<RecordingMainPage> {
protected:
  void SetUp() override {
    PageTest::SetUp();
    ZEPStdSetup::SetStandardFiles("drafting", {"JIS.xml", "ANSI.xml", "notes.txt", "ISO.xml"});
    _script.answers["GetFrameIconName"] = "I_MainOptions";
  }
  // Every optional part present, two PLM standards, the first one current.
  void ScriptEveryPart() {
    _script.allInfoSet = true;
    _script.storeWrites = true;
    _script.textLists = {{"StandardPLMList", {"Company A", "Company B"}}, {"StandardPLMIDList", {"key-a", "key-b"}}};
    _script.texts = {{"StandardName", "key-a"}};
    _script.values = {{"IsStandardPLM", {1}}, {"InsertDrawing", {1}}, {"ScaleRatio", {0.5, 100, 10000, 0.01, 0.0001}}};
  }
  void OpenEveryPart() {
    ScriptEveryPart();
    Open();
  }
  // A fresh page in a window of its own, built: the rows it used.
  int Build() {
    delete _pWindow;
    _pWindow = new ZEPDlgWindow(&_root, "window", 0);
    _pPage = new RecordingMainPage(_script, _pWindow);
    return _pPage->Build();
  }
  int Open() {
    const int rows = Build();
    _pPage->Initialize();
    return rows;
  }
  ZEPDlgCombo* StdCombo() { return Combo("cmbStandardName"); }
  ZEPDlgEditor* Editor(const char* iName) { return As<ZEPDlgEditor>(iName); }
  // The standard combo's lines, with their icons.
  Strings Lines() {
    Strings out;
    for (int i = 0; i < StdCombo()->GetLineCount(); ++i) {
      ZEPUnicodeString text;
      ZEPString icon;
      StdCombo()->GetLine(text, i);
      StdCombo()->GetLineIconName(icon, i);
      out.push_back(icon.empty() ? text.str() : text.str() + " <" + icon + ">");
    }
    return out;
  }
  std::string Selected() { return ComboLine(*StdCombo(), StdCombo()->GetSelect()); }
  // The written value of iHook's last call: its text, or its first number.
  std::string Written(const char* iHook) {
    auto calls = _script.Calls(iHook);
    if (calls.empty()) return "(not written)";
    return calls.back().values.empty() ? calls.back().text : std::to_string(int(calls.back().values[0]));
  }
};
} // namespace

// ---- parts of the page -------------------------------------------------------------------------
TEST_F(MainPage, ModuleHooksShowOnlyTheStandardComboWithAnEmptyLineFirst) {
  EXPECT_EQ(Open(), 1); // the combo's lines and what it shows are in the dump
  EXPECT_EQ(ZEPCheckLog::Count(), 0);
  ExpectGolden("main_page_module_hooks.dump", ZEPDlgDriver::Dump(_pPage));
}

TEST_F(MainPage, EachOptionalPartExistsExactlyWhenItsInfoHookDoesNotFail) {
  const struct {
    const char* attribute;
    const char* widget;
    int rows; // rows used when present
  } parts[] = {{"StandardPLMAdd", "pusStandardPLMAdd", 1},
               {"StandardPLMRemove", "pusStandardPLMRemove", 1},
               {"InsertDrawing", "chkInsertDrawing", 2},
               {"MakeDrawingShareable", "chkMakeDrawingShareable", 2},
               {"ScaleRatio", "edtScaleRatio", 2}};
  for (const auto& part : parts)
    for (long status : {E_FAIL, -1L, 0L, 1L}) {
      _script.info = {{part.attribute, status}};
      const int rows = Build();
      const bool present = status >= 0;
      EXPECT_EQ(Find(part.widget) != nullptr, present) << part.attribute << " " << status;
      EXPECT_EQ(rows, present ? part.rows : 1) << part.attribute << " " << status;
    }
  // Rows follow each other in the order insert, shareable, scale ratio.
  _script.info = {{"MakeDrawingShareable", 0}, {"ScaleRatio", 0}};
  EXPECT_EQ(Open(), 3);
  EXPECT_EQ(Row("frmScaleRatio"), 2);
}

TEST_F(MainPage, EveryPartPresent) {
  ScriptEveryPart();
  EXPECT_EQ(Open(), 4);
  EXPECT_EQ(Lines(), (Strings{"ANSI <I_D3M_Folder>", "ISO <I_D3M_Folder>", "JIS <I_D3M_Folder>",
                              "Company A <I_D3M_Database>", "Company B <I_D3M_Database>"}));
  EXPECT_EQ(ZEPCheckLog::Count(), 0);
  ExpectGolden("main_page_every_part.dump", ZEPDlgDriver::Dump(_pPage));
}

TEST_F(MainPage, PLMListsThatDoNotPairUpAreDropped) {
  ScriptEveryPart();
  _script.textLists["StandardPLMIDList"] = {"key-a"};
  Open();
  EXPECT_EQ(Lines(),
            (Strings{"key-a <I_D3M_Database>", "ANSI <I_D3M_Folder>", "ISO <I_D3M_Folder>", "JIS <I_D3M_Folder>"}));
  EXPECT_FALSE(Enabled("pusStandardPLMRemove"));
}

// ---- choosing a standard -----------------------------------------------------------------------
TEST_F(MainPage, ChoosingAFolderOrAPLMStandardWritesTheNameThenTheFlag) {
  OpenEveryPart();
  ASSERT_TRUE(ZEPDlgDriver::Select(StdCombo(), 1)); // ISO
  EXPECT_EQ(Hooks(), (Strings{"SetSysStandardName", "SetSysIsStandardPLM"}));
  EXPECT_EQ(Written("SetSysStandardName"), "ISO");
  EXPECT_EQ(Written("SetSysIsStandardPLM"), "0");
  EXPECT_EQ(Selected(), "ISO");
  _script.calls.clear();
  ASSERT_TRUE(ZEPDlgDriver::Select(StdCombo(), 4)); // Company B
  EXPECT_EQ(Hooks(), (Strings{"SetSysStandardName", "SetSysIsStandardPLM"}));
  EXPECT_EQ(Written("SetSysStandardName"), "key-b");
  EXPECT_EQ(Written("SetSysIsStandardPLM"), "1");
  EXPECT_EQ(ZEPCheckLog::Count(), 0);
}

TEST_F(MainPage, TheCurrentLineWritesNothingUnlessTheStoredFlagDisagrees) {
  ScriptEveryPart();
  _script.texts["StandardName"] = "ISO";
  _script.values["IsStandardPLM"] = {0};
  Open();
  ASSERT_TRUE(ZEPDlgDriver::Select(StdCombo(), 1));
  EXPECT_TRUE(_script.calls.empty());
  // The host says PLM while a folder standard of that name is shown: both are written.
  _script.values["IsStandardPLM"] = {1};
  ASSERT_TRUE(ZEPDlgDriver::Select(StdCombo(), 1));
  EXPECT_EQ(Hooks(), (Strings{"SetSysStandardName", "SetSysIsStandardPLM"}));
  EXPECT_EQ(Written("SetSysIsStandardPLM"), "0");
}

TEST_F(MainPage, TwoPLMStandardsWithTheSameDisplayNameKeepTheirOwnKeys) {
  ScriptEveryPart();
  _script.textLists = {{"StandardPLMList", {"Same", "Other", "Same"}},
                       {"StandardPLMIDList", {"key-1", "key-2", "key-3"}}};
  _script.texts["StandardName"] = "ISO";
  _script.values["IsStandardPLM"] = {0};
  Open();
  ASSERT_TRUE(ZEPDlgDriver::Select(StdCombo(), 5)); // the second "Same"
  EXPECT_EQ(Written("SetSysStandardName"), "key-3");
  _script.values["IsStandardPLM"] = {1};
  ASSERT_TRUE(ZEPDlgDriver::Select(StdCombo(), 3)); // the first "Same"
  EXPECT_EQ(Written("SetSysStandardName"), "key-1");
  EXPECT_EQ(Selected(), "Same");
  EXPECT_EQ(StdCombo()->GetSelect(), 3);
}

TEST_F(MainPage, TheListOffersOnlyChoicesWhileOpenAndTheStoredNameAgainWhenClosed) {
  _script.texts["StandardName"] = "Gone";
  Open();
  ASSERT_EQ(Lines().front(), "Gone");
  ASSERT_TRUE(ZEPDlgDriver::DropDown(StdCombo()));
  EXPECT_EQ(Lines(), (Strings{"ANSI", "ISO", "JIS"}));
  EXPECT_EQ(Selected(), ""); // none
  ASSERT_TRUE(ZEPDlgDriver::CloseUp(StdCombo()));
  EXPECT_EQ(Lines(), (Strings{"Gone", "ANSI", "ISO", "JIS"}));
  // A notification with nothing selected writes nothing.
  StdCombo()->SendNotification(StdCombo()->GetComboSelectNotification());
  EXPECT_TRUE(_script.calls.empty());
  EXPECT_EQ(ZEPCheckLog::Count(), 0);
}

// ---- adding and removing PLM standards --------------------------------------------------------
TEST_F(MainPage, ValidatedChoiceAddsTheNewStandardsAndMakesTheFirstCurrent) {
  OpenEveryPart();
  const int live = ZEPRefCounted::LiveCount();
  ASSERT_TRUE(Click("pusStandardPLMAdd"));
  ZEPIPLMChooser* chooser = ZEPPLMSetup::LiveChooser();
  ASSERT_NE(chooser, nullptr);
  EXPECT_EQ(chooser->GetVisibility(), ZEPDlgShow);
  EXPECT_EQ(chooser->GetParent(), _pPage);
  EXPECT_EQ(chooser->GetTypeNames(), Strings{"DIFStandardRep"}); // it offers standards only
  EXPECT_EQ(chooser->GetCommand()->GetFather(), _pPage);

  ASSERT_TRUE(ZEPPLMSetup::Validate({{"Ünïcode std", "key-c"}, {"Company D", "key-d"}, {"Renamed A", "key-a"}}));
  EXPECT_EQ(Hooks(),
            (Strings{"SetSysStandardPLMList", "SetSysStandardPLMIDList", "SetSysStandardName", "SetSysIsStandardPLM"}));
  EXPECT_EQ(Written("SetSysStandardPLMList"), "Company A\nCompany B\nÜnïcode std\nCompany D\n");
  EXPECT_EQ(Written("SetSysStandardPLMIDList"), "key-a\nkey-b\nkey-c\nkey-d\n");
  EXPECT_EQ(Written("SetSysStandardName"), "key-c");
  EXPECT_EQ(Written("SetSysIsStandardPLM"), "1");
  EXPECT_EQ(Selected(), "Ünïcode std");
  EXPECT_EQ(ZEPPLMSetup::LiveChooser(), nullptr);
  EXPECT_EQ(ZEPRefCounted::LiveCount(), live);
  EXPECT_EQ(ZEPCheckLog::Count(), 0);
}

TEST_F(MainPage, ObjectsWithoutInterfacesOrAReliableKeyAreSkippedAndReported) {
  OpenEveryPart();
  const int live = ZEPRefCounted::LiveCount();
  ZEPPLMSetup::Standard noComponent{"No component", "key-1"}, noAlias{"No alias", "key-2"},
      keyFails{"Key fails", "key-3"}, notUnique{"Not unique", "key-4", -1}, good{"Good", "key-5"};
  noComponent.withComponent = false;
  noAlias.withAlias = false;
  keyFails.keyQueryFails = true;
  ASSERT_TRUE(Click("pusStandardPLMAdd"));
  ASSERT_TRUE(ZEPPLMSetup::Validate({noComponent, noAlias, keyFails, notUnique, good}));
  EXPECT_EQ(Written("SetSysStandardPLMIDList"), "key-a\nkey-b\nkey-5\n");
  EXPECT_EQ(Written("SetSysStandardName"), "key-5");
  ASSERT_EQ(ZEPCheckLog::Count(), 4);
  for (const ZEPCheckEntry& e : ZEPCheckLog::Entries()) {
    EXPECT_EQ(e.reporter, "CheckFailure__");
    EXPECT_EQ(e.expression, "");
    EXPECT_EQ(e.path, "DraftingBaseSettings/ZEPDbsBaseSettings.m/src/ZEP2DBaseOptMainFrm");
  }
  EXPECT_EQ(ZEPRefCounted::LiveCount(), live);
}

TEST_F(MainPage, CancelledOrPressedTwiceTheChooserStaysTheOneThePageHolds) {
  OpenEveryPart();
  const int live = ZEPRefCounted::LiveCount();
  ASSERT_TRUE(Click("pusStandardPLMAdd"));
  ASSERT_TRUE(ZEPPLMSetup::Cancel());
  EXPECT_TRUE(_script.calls.empty());
  EXPECT_EQ(ZEPPLMSetup::LiveChooser(), nullptr);
  EXPECT_EQ(ZEPRefCounted::LiveCount(), live);

  // A second push shows the open chooser again; its choice still reaches the page.
  ASSERT_TRUE(Click("pusStandardPLMAdd"));
  ZEPIPLMChooser* first = ZEPPLMSetup::LiveChooser();
  first->SetVisibility(ZEPDlgHide);
  ASSERT_TRUE(Click("pusStandardPLMAdd"));
  EXPECT_EQ(ZEPPLMSetup::ChoosersCreated(), 2);
  EXPECT_EQ(ZEPPLMSetup::LiveChooser(), first);
  EXPECT_EQ(first->GetVisibility(), ZEPDlgShow);
  ASSERT_TRUE(ZEPPLMSetup::Validate({{"Company E", "key-e"}}));
  EXPECT_EQ(Written("SetSysStandardName"), "key-e");
  EXPECT_EQ(ZEPRefCounted::LiveCount(), live);
  EXPECT_EQ(ZEPCheckLog::Count(), 0);
}

TEST_F(MainPage, ChooserServicesThatFailAreReportedAndLeaveNothingBehind) {
  OpenEveryPart();
  const int live = ZEPRefCounted::LiveCount();
  const struct {
    void (*setup)();
    const char* check;
  } cases[] = {{[] { ZEPPLMSetup::SetFactoryAvailable(false); }, "pChooserFactory"},
               {[] { ZEPPLMSetup::SetChooserCreationFails(true); }, "_pPLMObjectChooser"},
               {[] { ZEPPLMSetup::SetChooserWithCommand(false); }, "pPLMChooserCommand"}};
  for (const auto& c : cases) {
    ZEPPLMSetup::Reset();
    ZEPCheckLog::Clear();
    c.setup();
    ASSERT_TRUE(Click("pusStandardPLMAdd"));
    ASSERT_EQ(ZEPCheckLog::Count(), 1) << c.check;
    EXPECT_EQ(ZEPCheckLog::Entries()[0].reporter, "Check_Pointer_Failed__");
    EXPECT_EQ(ZEPCheckLog::Entries()[0].expression, c.check);
    EXPECT_EQ(ZEPPLMSetup::LiveChooser(), nullptr) << c.check;
    EXPECT_EQ(ZEPRefCounted::LiveCount(), live) << c.check;
  }
  // Once the host has choosers again, the button works.
  ZEPPLMSetup::Reset();
  ASSERT_TRUE(Click("pusStandardPLMAdd"));
  EXPECT_NE(ZEPPLMSetup::LiveChooser(), nullptr);
  EXPECT_TRUE(_script.calls.empty());
}

TEST_F(MainPage, APageClosedWithItsChooserOpenReleasesIt) {
  ScriptEveryPart();
  const int live = ZEPRefCounted::LiveCount();
  Open();
  ASSERT_TRUE(Click("pusStandardPLMAdd"));
  ZEPIPLMChooser* chooser = ZEPPLMSetup::LiveChooser();
  chooser->AddRef(); // someone else still holds it
  delete _pPage;
  EXPECT_EQ(chooser->GetVisibility(), ZEPDlgHide);
  EXPECT_EQ(chooser->GetCommand()->GetFather(), nullptr);
  chooser->Release();
  EXPECT_EQ(ZEPRefCounted::LiveCount(), live);
}

TEST_F(MainPage, RemovingTheCurrentPLMStandard) {
  for (const char* fallback : {"ISO", "Not a folder standard"}) {
    _script.calls.clear();
    ScriptEveryPart();
    _script.answers["GetDefaultStandardName"] = fallback;
    Open();
    ASSERT_TRUE(Click("pusStandardPLMRemove"));
    EXPECT_EQ(Written("SetSysStandardPLMList"), "Company B\n");
    EXPECT_EQ(Written("SetSysStandardPLMIDList"), "key-b\n");
    if (std::string(fallback) == "ISO") {
      EXPECT_EQ(Hooks().size(), 4u);
      EXPECT_EQ(Written("SetSysStandardName"), "ISO");
      EXPECT_EQ(Written("SetSysIsStandardPLM"), "0");
    } else {
      // The host still stores the removed key as current; the page shows the default.
      EXPECT_EQ(Hooks().size(), 2u);
      EXPECT_EQ(Lines().front(), "Not a folder standard <I_D3M_Database>");
    }
    EXPECT_FALSE(Enabled("pusStandardPLMRemove"));
  }
  EXPECT_EQ(ZEPCheckLog::Count(), 0);
}

// ---- scale ratio -------------------------------------------------------------------------------
TEST_F(MainPage, RatioEntriesAreStoredForTheShownRangeWithinItsTolerances) {
  OpenEveryPart();
  ZEPDlgEditor* ratio = Editor("edtScaleRatio");
  const struct {
    const char* typed;
    const char* shown;
    double stored; // 0: refused
  } entries[] = {{"1:50", "1:50", 0.02},     {"1/4", "1:4", 0.25}, {"2", "2:1", 2.0},      {"0.75", "3:4", 0.75},
                 {"abc", "3:4", 0},          {"1:0", "3:4", 0},    {"1:100000", "3:4", 0}, {"1:1000", "1:1000", 0.001},
                 {"1000", "1000:1", 1000.0}, {"1001", "1000:1", 0}};
  for (const auto& e : entries) {
    _script.calls.clear();
    ASSERT_TRUE(ZEPDlgDriver::EnterText(ratio, e.typed));
    EXPECT_EQ(ratio->GetText().str(), e.shown) << e.typed;
    if (e.stored == 0) {
      EXPECT_TRUE(_script.calls.empty()) << e.typed;
      continue;
    }
    ASSERT_EQ(Hooks(), Strings{"SetSysScaleRatio"}) << e.typed;
    EXPECT_EQ(_script.calls[0].values, (std::vector<double>{e.stored, 100, 10000, 0.01, 0.0001})) << e.typed;
  }
  // Another range shows its own ratio and bounds, and writes nothing.
  _script.calls.clear();
  ASSERT_TRUE(ZEPDlgDriver::Select(Control("cmbRatioRange"), 1));
  EXPECT_TRUE(_script.calls.empty());
  EXPECT_EQ(ratio->GetText().str(), "100:1");
  EXPECT_EQ(Editor("edtScaleRatioDec")->GetText().str(), "100");
  ASSERT_TRUE(ZEPDlgDriver::EnterText(ratio, "1:50")); // below 0.1 at this range
  EXPECT_TRUE(_script.calls.empty());
  ASSERT_TRUE(ZEPDlgDriver::EnterText(ratio, "500"));
  ASSERT_EQ(_script.calls.size(), 1u);
  EXPECT_EQ(_script.calls[0].values, (std::vector<double>{1000, 500, 10000, 0.01, 0.0001}));
  EXPECT_EQ(ZEPCheckLog::Count(), 0);
}

TEST_F(MainPage, ANonPositiveToleranceRefusesEveryEntry) {
  OpenEveryPart();
  for (double tolerance : {0.0, -0.001}) {
    ZEPScaleToolboxSetup::Reset();
    ZEPScaleToolboxSetup::SetTolerance(ZEPCkeScaleNormal, 6, tolerance);
    ASSERT_TRUE(ZEPDlgDriver::EnterText(Editor("edtScaleRatio"), "2"));
    ZEPScaleToolboxSetup::Reset();
    ZEPScaleToolboxSetup::SetTolerance(ZEPCkeScaleNormal, 7, tolerance);
    ASSERT_TRUE(ZEPDlgDriver::EnterText(Editor("edtScaleRatio"), "2"));
  }
  EXPECT_TRUE(_script.calls.empty());
  EXPECT_EQ(Editor("edtScaleRatio")->GetText().str(), "1:2");
}

TEST_F(MainPage, WithoutScalesServiceTheFirstRangeStaysShown) {
  ZEPScalesSetup::SetAvailable(false);
  OpenEveryPart();
  ZEPCheckLog::Clear();
  EXPECT_EQ(Editor("edtScaleRatio")->GetText().str(), "1:2");
  ASSERT_TRUE(ZEPDlgDriver::EnterText(Editor("edtScaleRatio"), "1:5"));
  ASSERT_EQ(_script.calls.size(), 1u);
  EXPECT_EQ(_script.calls[0].values[0], 0.2);
}

// ---- flags and locks ---------------------------------------------------------------------------
TEST_F(MainPage, ShareableFollowsInsertDrawingButItsLockWins) {
  OpenEveryPart();
  ASSERT_TRUE(Click("chkInsertDrawing"));
  EXPECT_FALSE(Enabled("chkMakeDrawingShareable"));
  ASSERT_TRUE(Click("chkInsertDrawing"));
  ASSERT_TRUE(Click("chkMakeDrawingShareable"));
  EXPECT_EQ(Hooks(), (Strings{"SetSysInsertDrawing", "SetSysInsertDrawing", "SetSysMakeDrawingShareable"}));
  EXPECT_EQ(Written("SetSysMakeDrawingShareable"), "1");
}

TEST_F(MainPage, EachLockStopsItsOwnControlsOnly) {
  const struct {
    const char* attribute;
    Strings stopped;
  } locks[] = {{"StandardName", {"cmbStandardName"}},
               {"StandardPLMAdd", {"pusStandardPLMAdd"}},
               {"StandardPLMRemove", {"pusStandardPLMRemove"}},
               {"InsertDrawing", {"chkInsertDrawing"}},
               {"MakeDrawingShareable", {"chkMakeDrawingShareable"}},
               {"ScaleRatio", {"edtScaleRatio", "cmbRatioRange"}}};
  const Strings all = {"cmbStandardName",         "pusStandardPLMAdd", "pusStandardPLMRemove", "chkInsertDrawing",
                       "chkMakeDrawingShareable", "edtScaleRatio",     "cmbRatioRange"};
  for (const auto& lock : locks) {
    ScriptEveryPart();
    _script.locked = {lock.attribute};
    Open();
    for (const std::string& name : all) {
      const bool stopped = std::find(lock.stopped.begin(), lock.stopped.end(), name) != lock.stopped.end();
      EXPECT_EQ(Enabled(name.c_str()), !stopped) << lock.attribute << " " << name;
    }
  }
}
