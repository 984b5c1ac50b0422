// Administration page and its property toolbar behaviour dialog: the host's operations, the
// info gates, radio groups in lock frames, the sensitivity rules, the template creation
// warning, the environment section and the dialog's rows, lines and placement.
#include "RecordingPages.h"

#include <algorithm>

namespace {
class AdminPage : public PageTest<RecordingAdminPage> {
protected:
  ZEPDlgDialog* PushBehavior() { return OpenDialog("pushPropTbBehavior", "dlgPropTbBehavior"); }
  int WithFrmGVSCalls() {
    return static_cast<int>(std::count(_script.reads.begin(), _script.reads.end(), "WithFrmGVS"));
  }
};

std::string Text(const char* iKey) { return ZEPMsgCatalog::BuildMessage("ZEP2DBaseOptAdminFrm", iKey).str(); }
} // namespace

TEST_F(AdminPage, ModuleHooksBuildOnlyWhatNeedsNoInfo) {
  Open(); // which controls are built, and where, is in the dump
  EXPECT_EQ(ZEPCheckLog::Count(), 0);
  ExpectGolden("admin_page_module_hooks.dump", ZEPDlgDriver::Dump(_pPage));
}

TEST_F(AdminPage, BuildFlagAndHostOperationsDecideTheFrames) {
  _script.allInfoSet = true;
  const struct {
    long flag, gvs, assembly, titleBlock;
  } cases[] = {{0, 1, 1, 1}, {1, 1, 1, 1}, {0, 0, 0, 0}, {1, 0, 1, 0}};
  for (const auto& c : cases) {
    _script.options = {{"BuildFlag", c.flag},
                       {"WithFrmGVS", c.gvs},
                       {"WithFrmAssemblyMgmt", c.assembly},
                       {"WithFrmTitleBlock", c.titleBlock}};
    Open();
    const std::string when = "flag " + std::to_string(c.flag);
    for (const char* styles : {"chkDisableTemplateCreation", "chkDisableGenMfgRequirements", "toolDrwStyle"})
      EXPECT_EQ(Find(styles) != nullptr, c.flag == 0) << styles << when;
    EXPECT_EQ(Find("toolGVS") != nullptr, c.gvs != 0) << when;
    EXPECT_EQ(Find("toolAssemblyMgmt") != nullptr, c.assembly != 0) << when;
    EXPECT_EQ(Find("frameTitleBlock") != nullptr, c.titleBlock != 0) << when;
    // The frames that exist fill rows 0, 1, 2, ... of the page.
    short expected = 0;
    for (ZEPDialog* frame : _pPage->GetChildren())
      EXPECT_EQ(frame->GetGridConstraints().row, expected++) << frame->GetOwnName() << when;
  }
}

TEST_F(AdminPage, InfoGatesNotNegativeOrExactlyZero) {
  const struct {
    const char* attribute;
    const char* widget;
    long status;
    bool built;
  } cases[] = {
      // (Each control built when every info hook answers 0 is in the dump.)
      {"PrevSwitchStd", "checkSwitchStandard", 1, true},
      {"PrevSwitchStd", "checkSwitchStandard", -1, false},
      {"PrevBackgroundAccess", "checkBackgroundView", E_NOTIMPL, false},
      {"PreventRootUpgrade", "chkPreventRootUpgrade", 2, true},
      {"PreventViewUpgrade", "chkPrevViewGeomUpgrade", 1, true},
      {"PreventViewUpgrade", "chkPrevViewGeomUpgrade", -1, false},
      {"DisableTemplateCreation", "chkDisableTemplateCreation", 1, true},
      {"DisableGenMfgRequirements", "chkDisableGenMfgRequirements", -5, false},
      {"SheetNamesUnicity", "checkSheetNamesUnicity", 1, false},
      {"ViewNameUnicityScope", "radViewNameUnicityInLayout", 1, false},
      {"CaptureNamesUnicity", "chkCaptureNamesUnicity", 1, false},
      {"EnggConLocation", "LblEngineeringConnectionLocation", 1, false},
      // Controls whose status is not looked at.
      {"PrevViewGeomUpgrade", "chkPrevViewGeomUpgrade", -1, true},
      {"SelectionOnCurrentAssembly", "radElemUnderCurAssemblyRoot", -1, true},
      {"ShowWarningSelectionOutAssembly", "chkShowWarningSelectionOutAssembly", -1, true},
  };
  for (const auto& c : cases) {
    _script.allInfoSet = true;
    _script.info = {{c.attribute, c.status}};
    Open();
    EXPECT_EQ(Find(c.widget) != nullptr, c.built) << c.widget << " with " << c.attribute << " info " << c.status;
  }
}

TEST_F(AdminPage, EnvironmentSectionShowsTrueDimensionsWithTheirOwnPadlock) {
  _script.allInfoSet = true;
  Open();
  EXPECT_EQ(Find("toolDress"), nullptr);
  setenv("ZEP_TDE_LA", "", 1);
  for (bool trueDimLocked : {true, false}) {
    // The control built just before is locked exactly when this one is not.
    _script.locked = {trueDimLocked ? "PrevTrueDim" : "EnggConLocation"};
    _script.values = {{"PrevTrueDim", {1}}};
    Open();
    ASSERT_NE(Find("toolDress"), nullptr);
    EXPECT_TRUE(Checked("chkPrevTrueDim"));
    EXPECT_EQ(Enabled("chkPrevTrueDim"), !trueDimLocked);
    _script.calls.clear();
    EXPECT_EQ(Click("chkPrevTrueDim"), !trueDimLocked);
    EXPECT_EQ(Hooks().size(), trueDimLocked ? 0u : 1u);
  }
}

TEST_F(AdminPage, ScopeRuleOfTheAssemblyWarningsUnderPadlocks) {
  const struct {
    int scope;
    int warnOut;
    const char* locked;
    bool outEnabled, favouriteEnabled;
  } cases[] = {{0, 0, "", false, false},
               {1, 0, "", true, false},
               {2, 0, "", true, true},
               {2, 1, "", true, false},
               {2, 0, "ShowWarningSelectionOutFavoriteContext", true, false},
               {1, 0, "SelectionOnCurrentAssembly", true, false}};
  for (const auto& c : cases) {
    _script.allInfoSet = true;
    _script.locked = {c.locked};
    _script.values = {{"SelectionOnCurrentAssembly", {double(c.scope)}},
                      {"ShowWarningSelectionOutAssembly", {double(c.warnOut)}}};
    Open();
    const std::string when = "scope " + std::to_string(c.scope) + " locked " + c.locked;
    EXPECT_EQ(Enabled("chkShowWarningSelectionOutAssembly"), c.outEnabled) << when;
    EXPECT_EQ(Enabled("chkShowWarningSelectionOutFavoriteContext"), c.favouriteEnabled) << when;
  }
  // Changing the scope and the out-of-assembly warning applies the rule at once.
  _script.locked.clear();
  _script.values = {{"SelectionOnCurrentAssembly", {0}}};
  Open();
  ASSERT_TRUE(Click("radAnyRelevantElement"));
  EXPECT_TRUE(Enabled("chkShowWarningSelectionOutAssembly"));
  EXPECT_TRUE(Enabled("chkShowWarningSelectionOutFavoriteContext"));
  ASSERT_TRUE(Click("chkShowWarningSelectionOutAssembly"));
  EXPECT_FALSE(Enabled("chkShowWarningSelectionOutFavoriteContext"));
  ASSERT_TRUE(Click("radElemUnderCurAssemblyRoot"));
  EXPECT_FALSE(Enabled("chkShowWarningSelectionOutAssembly"));
}

TEST_F(AdminPage, DependantsFollowTheirChecksAndLocksWin) {
  _script.allInfoSet = true;
  _script.values = {{"SheetNamesUnicity", {1}}, {"FilterNamesUnicity", {1}}, {"ViewNamesUnicity", {1}}};
  _script.locked = {"DistinguishCaseInUnicity"};
  Open();
  // The view name scope radios follow the view name check; distinguishing needs one unique name
  // check. (What each radio group shows and writes is a test of every page.)
  EXPECT_TRUE(Enabled("radViewNameUnicityInSheet"));
  ASSERT_TRUE(Click("checkViewNamesUnicity"));
  EXPECT_FALSE(Enabled("radViewNameUnicityInSheet"));
  EXPECT_FALSE(Enabled("radViewNameUnicityInLayout"));
  EXPECT_TRUE(Enabled("chkDistinguishCodeInUnicity"));
  EXPECT_FALSE(Enabled("chkDistinguishCaseInUnicity"));
  ASSERT_TRUE(Click("checkSheetNamesUnicity"));
  EXPECT_TRUE(Enabled("chkDistinguishCodeInUnicity"));
  ASSERT_TRUE(Click("checkFilterNamesUnicity")); // the last one
  EXPECT_FALSE(Enabled("chkDistinguishCodeInUnicity"));
  EXPECT_FALSE(Enabled("chkDistinguishCaseInUnicity"));
  ASSERT_TRUE(Click("chkCaptureNamesUnicity"));
  EXPECT_TRUE(Enabled("chkDistinguishCodeInUnicity"));
  EXPECT_FALSE(Enabled("chkDistinguishCaseInUnicity")) << "locked";
  // Dependants of other checks follow them too.
  ASSERT_TRUE(Click("chkPreventGVS"));
  EXPECT_FALSE(Enabled("chkGVSParamOverride"));
  ASSERT_TRUE(Click("chkPreventViewUpgrade"));
  EXPECT_FALSE(Enabled("chkPrevViewGeomUpgrade"));
  ASSERT_TRUE(Click("chkPreventViewUpgrade"));
  EXPECT_TRUE(Enabled("chkPrevViewGeomUpgrade"));
}

TEST_F(AdminPage, TemplateCreationWarnsOnEveryToggle) {
  _script.allInfoSet = true;
  Open();
  for (double expected : {1.0, 0.0}) {
    _script.calls.clear();
    ASSERT_TRUE(Click("chkDisableTemplateCreation"));
    ASSERT_EQ(Hooks(), std::vector<std::string>{"SetSysDisableTemplateCreation"});
    EXPECT_EQ(_script.calls[0].values[0], expected);
    ASSERT_EQ(ZEPMessageBoxSetup::OnScreen().size(), 1u);
    ZEPVidFraMessageBox* box = ZEPMessageBoxSetup::OnScreen()[0];
    EXPECT_EQ(box->GetOwnName(), "ZEP2DBaseOptAdminFrmMsg");
    EXPECT_EQ(box->GetTitle().str(), Text("DisableTemplateCreationWng.Title"));
    EXPECT_EQ(box->GetInformativeText().str(), Text("DisableTemplateCreationWng.Message"));
    EXPECT_TRUE(box->Answer(32)); // its one button
    EXPECT_TRUE(ZEPMessageBoxSetup::OnScreen().empty());
    ZEPDlgDriver::Idle(); // the box closed itself
    EXPECT_EQ(Find("ZEP2DBaseOptAdminFrmMsg"), nullptr);
  }
  EXPECT_EQ(ZEPMessageBoxSetup::ShownCount(), 2);
}

TEST_F(AdminPage, FolderIsWrittenWhenItsTextChanges) {
  _script.texts = {{"FolderTitleBlock", "/srv/frames"}};
  Open();
  auto* editor = ZEPSysDynamicCast<ZEPDlgEditor>(Control("FrameAndTitleBlockPath"));
  ASSERT_NE(editor, nullptr);
  EXPECT_EQ(editor->GetText().str(), "/srv/frames");
  for (const char* text : {"/srv/frames", "/srv/titles", "/srv/titles", ""})
    ASSERT_TRUE(ZEPDlgDriver::EnterText(editor, text));
  ASSERT_EQ(Hooks(), std::vector<std::string>(2, "SetSysFolderTitleBlock"));
  EXPECT_EQ(_script.calls[0].text, "/srv/titles");
  EXPECT_EQ(_script.calls[1].text, "");
}

// ---- property toolbar behaviour dialog -----------------------------------------------------
TEST_F(AdminPage, BehaviorDialogShowsOnlyRowsWhoseInfoAnswersZero) {
  Open();
  ZEPDlgDialog* dialog = PushBehavior();
  ASSERT_NE(dialog, nullptr);
  EXPECT_EQ(Row("lblPropertyBehavior", dialog), 0);
  EXPECT_EQ(Find("cmbDrwTbFontName", dialog), nullptr);
  ZEPDlgDriver::CloseDialog(dialog);
  ZEPDlgDriver::Idle();

  _script.allInfoSet = true;
  _script.info = {{"DrwTbBold", 1}, {"DrwTbPattern", -1}};
  Open();
  dialog = PushBehavior();
  int rows = 0;
  for (const std::string& name : kAdminAttributes) {
    if (name.rfind("DrwTb", 0) != 0) continue;
    ZEPDialog* combo = Find("cmb" + name, dialog);
    const bool shown = name != "DrwTbBold" && name != "DrwTbPattern";
    ASSERT_EQ(combo != nullptr, shown) << name;
    if (!shown) continue;
    // Rows move up past the missing ones.
    EXPECT_EQ(combo->GetGridConstraints().row, ++rows) << name;
    EXPECT_EQ(Row("lbl" + name, dialog), rows) << name;
  }
  EXPECT_EQ(rows, 17);
}

TEST_F(AdminPage, BehaviorLinesAndConversionsWithAndWithoutGVS) {
  const std::string fix = Text("fix"), elem = Text("elemtype"), style = Text("style"), none = Text("nooverload");
  const std::vector<std::string> all = {fix, elem, style, none}, shifted = {elem, style, none},
                                 noElem = {fix, style, none};
  const struct {
    const char* row;
    int gvs;
    std::vector<std::string> lines;
    double stored;
    int shown;  // selected line
    int chosen; // line picked by the user
    double written;
  } cases[] = {
      {"DrwTbFontName", 1, all, 2, 2, 3, 3},        {"DrwTbFrame", 1, shifted, 0, -1, 0, 1},
      {"DrwTbNumDispDesc", 0, shifted, 3, 2, 1, 2}, {"DrwTbColor", 0, noElem, 1, 0, 1, 2},
      {"DrwTbColor", 1, all, 1, 1, 0, 0},           {"DrwTbPointType", 0, noElem, 0, 0, 2, 3},
      {"DrwTbPattern", 1, noElem, 3, 2, 0, 0},      {"DrwTbPattern", 0, noElem, 2, 1, 1, 2},
  };
  for (const auto& c : cases) {
    _script.allInfoSet = true;
    _script.options = {{"WithFrmGVS", c.gvs}};
    _script.values = {{c.row, {c.stored}}};
    Open();
    ZEPDlgDialog* dialog = PushBehavior();
    ASSERT_NE(dialog, nullptr);
    const std::string combo = std::string("cmb") + c.row;
    const std::string when = combo + " gvs " + std::to_string(c.gvs);
    EXPECT_EQ(Lines(combo), c.lines) << when;
    EXPECT_EQ(Combo(combo)->GetSelect(), c.shown) << when;
    _script.calls.clear();
    ASSERT_TRUE(ZEPDlgDriver::Select(Combo(combo), c.chosen)) << when;
    ASSERT_EQ(Hooks(), std::vector<std::string>{std::string("SetSys") + c.row}) << when;
    EXPECT_EQ(_script.calls[0].values[0], c.written) << when;
  }
}

TEST_F(AdminPage, GVSIsAskedAtEveryConversionAndLine) {
  _script.allInfoSet = true;
  Open();
  const int afterOpen = WithFrmGVSCalls();
  EXPECT_EQ(afterOpen, 1 + 4) << "the frame, then the four rows that depend on it";
  PushBehavior();
  EXPECT_EQ(WithFrmGVSCalls(), afterOpen + 4);
  ASSERT_TRUE(ZEPDlgDriver::Select(Combo("cmbDrwTbLineType"), 1));
  ASSERT_TRUE(ZEPDlgDriver::Select(Combo("cmbDrwTbLineType"), 2));
  ASSERT_TRUE(ZEPDlgDriver::Select(Combo("cmbDrwTbBold"), 2));
  EXPECT_EQ(WithFrmGVSCalls(), afterOpen + 6);
}

TEST_F(AdminPage, BehaviorDialogPlacementIsRestoredAndSaved) {
  _script.allInfoSet = true;
  Open();
  ZEPDlgDialog* dialog = nullptr;
  ZEPRect rect;
  ZEPSysPreferenceRepository* prefs = ZEPSysPreferenceRepository::Open("DraftingOptions");
  const char* const keys[] = {"dlgPropTbBehaviorX", "dlgPropTbBehaviorY", "dlgPropTbBehaviorWidth",
                              "dlgPropTbBehaviorHeight"};
  const struct {
    std::vector<int> stored; // empty: no key
    ZEPRect shown;
  } cases[] = {{{}, {440, 240, 440, 595}},
               {{10, 20, 300, 400}, {10, 20, 300, 400}},
               {{10, 20, 0, 400}, {440, 240, 440, 595}},
               {{10, 20, 300, -4}, {440, 240, 440, 595}}};
  for (const auto& c : cases) {
    for (int i = 0; i < 4; ++i) {
      prefs->ResetAttr(keys[i]);
      if (!c.stored.empty()) prefs->WritePreference(keys[i], &c.stored[i]);
    }
    dialog = PushBehavior();
    dialog->GetRectDimensions(&rect);
    EXPECT_EQ(std::vector<int>({rect.x, rect.y, rect.dx, rect.dy}),
              std::vector<int>({c.shown.x, c.shown.y, c.shown.dx, c.shown.dy}));
    // The user moves it; closing keeps the new place for the next opening.
    dialog->SetRectDimensions(ZEPRect{5, 6, 700, 800});
    ASSERT_TRUE(ZEPDlgDriver::CloseDialog(dialog));
    ZEPDlgDriver::Idle();
    int saved[4] = {};
    for (int i = 0; i < 4; ++i) prefs->ReadPreference(keys[i], &saved[i]);
    EXPECT_EQ(std::vector<int>(saved, saved + 4), (std::vector<int>{5, 6, 700, 800}));
    EXPECT_FALSE(prefs->IsModified()) << "saved";
  }

  // A host without a repository to save in keeps the stored place.
  _script.texts["SaveTo"] = "";
  dialog = PushBehavior();
  dialog->SetRectDimensions(ZEPRect{1, 2, 3, 4});
  ASSERT_TRUE(ZEPDlgDriver::CloseDialog(dialog));
  int width = 0;
  prefs->ReadPreference("dlgPropTbBehaviorWidth", &width);
  EXPECT_EQ(width, 700);
}

TEST_F(AdminPage, SecondPushShowsTheOpenDialogAndClosingForgetsItsCombos) {
  _script.allInfoSet = true;
  _script.values = {{"DrwTbItalic", {3}}};
  Open();
  ZEPDlgDialog* dialog = PushBehavior();
  dialog->SetVisibility(ZEPDlgHide);
  ASSERT_TRUE(Click("pushPropTbBehavior"));
  EXPECT_EQ(Children("dlgPropTbBehavior").size(), 1u);
  EXPECT_EQ(dialog->GetVisibility(), ZEPDlgShow);
  ZEPDlgCombo* italic = Combo("cmbDrwTbItalic");
  ASSERT_TRUE(ZEPDlgDriver::Select(italic, 1));
  ASSERT_TRUE(ZEPDlgDriver::Close(dialog));
  ASSERT_TRUE(ZEPDlgDriver::Select(italic, 2)); // closed, not yet destroyed: not written
  EXPECT_EQ(Hooks(), std::vector<std::string>{"SetSysDrwTbItalic"});
  ZEPDlgDriver::Idle();
  // Reopened, it shows the last value written.
  PushBehavior();
  EXPECT_EQ(Combo("cmbDrwTbItalic")->GetSelect(), 1);
  EXPECT_EQ(ZEPCheckLog::Count(), 0);
}

TEST_F(AdminPage, AllInfoHooksAnsweringZeroWithTheDialog) {
  _script.allInfoSet = true;
  _script.locked = {"ViewNameUnicityScope", "DrwTbSymbol"};
  _script.values = {
      {"ViewNamesUnicity", {1}}, {"SelectionOnCurrentAssembly", {2}}, {"PrevGenViewStyle", {1}}, {"DrwTbColor", {2}}};
  _script.texts = {{"FolderTitleBlock", "/srv/frames"}};
  setenv("ZEP_TDE_LA", "1", 1);
  Open();
  std::string dump = ZEPDlgDriver::Dump(_pPage);
  dump += ZEPDlgDriver::Dump(PushBehavior());
  ExpectGolden("admin_page_info_zero.dump", dump);
}
