// The drafting-options command line: in-process runs of RunCli, and end-to-end runs of the
// binary, each on settings files in a fresh temporary folder.
#include "SettingsFileSupport.h"
#include "ZEPAppBinding.h"
#include "ZEPAppCli.h"
#include "ZEPAppPages.h"
#include "ZEPAppRender.h"
#include "ZEPAppSettingsFile.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <regex>
#include <set>
#include <sstream>

#include <sys/wait.h>

using namespace zepapp;
namespace fs = std::filesystem;

namespace {

using Result = CliResult;
using Args = std::vector<std::string>;

// The texts of every control and section title in the page catalogs.
std::vector<std::string> CatalogTitles() {
  std::vector<std::string> titles;
  const std::regex titleLine(R"re(^\s*\w+\.Title\s*=\s*"(.*)";)re");
  for (const auto& entry : fs::directory_iterator(ZEPMsgCatalog::ResourceDir() + "/catalogs")) {
    std::ifstream in(entry.path());
    std::string line;
    std::smatch m;
    while (std::getline(in, line))
      if (std::regex_search(line, m, titleLine)) titles.push_back(m[1]);
  }
  return titles;
}

std::size_t Count(const std::string& iText, const std::string& iWhat) {
  std::size_t n = 0;
  for (auto at = iText.find(iWhat); at != std::string::npos; at = iText.find(iWhat, at + 1)) ++n;
  return n;
}

class AppCli : public SettingsFolderTest {
protected:
  void SetUp() override {
    SettingsFolderTest::SetUp();
    _settings = _user.string();
  }

  // In-process, on the folder's files.
  Result Run(std::vector<std::string> iArgs) {
    iArgs.insert(iArgs.begin(), {"--settings", _settings, "--admin", _admin});
    return RunInProcess(iArgs);
  }

  // The real binary, with the home and configuration folders moved into the temporary folder.
  Result RunBinary(const std::vector<std::string>& iArgs, bool iWithFiles = true) {
    std::string cmd = "env -u DRAFTING_OPTIONS_SETTINGS -u DRAFTING_OPTIONS_ADMIN -u XDG_CONFIG_HOME HOME=" +
                      ShellQuote(_dir.string()) + " " + ShellQuote(ZEP_APP_BINARY);
    if (iWithFiles) cmd += " --settings " + ShellQuote(_settings) + " --admin " + ShellQuote(_admin);
    for (const std::string& a : iArgs) cmd += " " + ShellQuote(a);
    return RunShell(cmd, _dir);
  }

  nlohmann::json UserFile() const { return nlohmann::json::parse(ReadBytes(_settings)); }
  // The stored values of an attribute of the user's file, as doubles.
  std::vector<double> Stored(const std::string& iRepository, const std::string& iAttribute) const {
    const nlohmann::json file = UserFile();
    const nlohmann::json& entry = file.at("settings").at(iRepository).at(iAttribute);
    const nlohmann::json& value = entry.contains("double") ? entry["double"] : entry.at("int");
    return value.is_array() ? value.get<std::vector<double>>() : std::vector<double>{value.get<double>()};
  }

  std::string _settings;
};

// The run ended with iCode and said iPart (on either stream).
::testing::AssertionResult Says(const Result& iRun, int iCode, const std::string& iPart) {
  if (iRun.code == iCode && (iRun.err + iRun.out).find(iPart) != std::string::npos)
    return ::testing::AssertionSuccess();
  return ::testing::AssertionFailure() << "exit code " << iRun.code << " (expected " << iCode << "), \"" << iPart
                                       << "\" expected in:\n"
                                       << iRun.err << iRun.out;
}

// The number a spinner shows and its unit symbol.
std::pair<double, std::string> Shown(const std::string& iText) {
  std::istringstream in(iText);
  std::pair<double, std::string> shown;
  in >> shown.first >> shown.second;
  return shown;
}

} // namespace

TEST_F(AppCli, SetOperatesEachKindOfControlAndPersists) {
  const ZEPAppSetting* axis = FindSetting("General", "2DAxisLength");
  const ZEPAppSetting* frame = FindSetting("General", "ViewFrame");
  const ZEPAppSetting* unit = FindSetting("General", "PaperLengthUnit");
  ASSERT_TRUE(axis && frame && unit);

  // A check box: off, then off again (no click, nothing new written).
  EXPECT_EQ(Run({"set", "general", frame->control, "off"}).code, kExitOk);
  EXPECT_EQ(Stored(frame->repository, frame->stored), std::vector<double>{0});
  const std::string saved = ReadBytes(_settings);
  EXPECT_TRUE(Says(Run({"set", "general", frame->control, "off"}), kExitOk, "unchanged"));
  EXPECT_EQ(ReadBytes(_settings), saved);
  EXPECT_EQ(Run({"get", "general", frame->control}).out, "off\n");

  // A length spinner, in its display unit or with a unit; stored in millimetres.
  const std::pair<const char*, double> lengths[] = {{"40", 40.0},     {"25mm", 25.0}, {"2.5cm", 25.0},
                                                    {"0.03 m", 30.0}, {"1in", 25.4},  {"1 ft", 304.8}};
  for (const auto& [typed, millimetres] : lengths) {
    ASSERT_EQ(Run({"set", "general", axis->control, typed}).code, kExitOk) << typed;
    ASSERT_EQ(Stored(axis->repository, axis->stored).size(), 1u);
    EXPECT_NEAR(Stored(axis->repository, axis->stored)[0], millimetres, 1e-9) << typed;
    const auto shown = Shown(Run({"get", "general", axis->control}).out);
    EXPECT_NEAR(shown.first, millimetres, 5e-4) << typed;
    EXPECT_EQ(shown.second, "mm");
  }

  // A combo by its line number (from 1), by its text, by the start of its text.
  const std::pair<const char*, double> lines[] = {{"2", 3}, {"Inch (in)", 5}, {"millim", 1}, {"cm", 3}};
  for (const auto& [typed, code] : lines) {
    ASSERT_EQ(Run({"set", "general", unit->control, typed}).code, kExitOk) << typed;
    EXPECT_EQ(Stored(unit->repository, unit->stored), std::vector<double>{code}) << typed;
  }
}

TEST_F(AppCli, BadValuesAreRefusedWithWhatTheControlAccepts) {
  const std::string axis = FindSetting("General", "2DAxisLength")->control;
  const std::string grad = FindSetting("Grid", "GradH")->control;
  const std::string unit = FindSetting("General", "PaperLengthUnit")->control;
  const struct {
    const char* page;
    std::string control;
    const char* typed;
    const char* told; // part of what the message must say
  } cases[] = {{"general", axis, "15deg", "length unit"},  {"general", axis, "abc", "not a number"},
               {"general", axis, "nan", "not a number"},   {"general", axis, "1e400", "too large"},
               {"general", axis, "-1mm", "from 0 mm to"},  {"general", axis, "200m", "outside the limits"},
               {"grid", grad, "12.5", "whole number"},     {"grid", grad, "3mm", "without a unit"},
               {"grid", grad, "0", "from 1 to"},           {"general", unit, "4", "Inch (in)"},
               {"general", unit, "parsec", "1  Millimetre (mm)"},
               {"general", FindSetting("General", "ViewFrame")->control, "maybe", "on or off"}};
  for (const auto& c : cases)
    EXPECT_TRUE(Says(Run({"set", c.page, c.control, c.typed}), kExitBadValue, c.told)) << c.typed;
  EXPECT_FALSE(fs::exists(_settings)); // nothing was ever written
}

TEST_F(AppCli, UnknownNamesListTheValidOnes) {
  const std::string page = Run({"show", "nosuchpage"}).err;
  for (const ZEPAppPage& p : AppPages()) EXPECT_TRUE(Has(page, p.name));
  const std::string control = Run({"set", "grid", "nosuchcontrol", "1"}).err;
  for (const ZEPAppSetting& s : AppSettings()) EXPECT_TRUE(s.page != "Grid" || Has(control, s.control));
  const struct {
    std::vector<std::string> args;
    const char* told;
  } cases[] = {{{"show", "nosuchpage"}, "grid"},
               {{"set", "grid", "nosuchcontrol", "1"}, "checkSnap"},
               {{"lock", "NoSuchAttribute"}, "'drafting-options list'"},
               {{"get", "DrwPaperLenghtUnit"}, "Did you mean DrwPaperLengthUnit?"},
               {{"shwo", "grid"}, "Did you mean show?"},
               {{"reset"}, ""},
               {{"show", "general", "--range", "2"}, ""}, // no scale range there
               {{"show", "grid", "--range", "6"}, ""},
               {{"reset", "grid", "cmbGridRange"}, ""}}; // it stores nothing
  for (const auto& c : cases) EXPECT_TRUE(Says(Run(c.args), kExitUsage, c.told)) << c.args[0];
  EXPECT_EQ(Run({"--version"}).code, kExitOk);
  EXPECT_FALSE(fs::exists(_settings));
}

TEST_F(AppCli, GridValuesPerScaleRangeAndTheDistortionRule) {
  const ZEPAppSetting* spacing = FindSetting("Grid", "PrimSpaceH");
  const ZEPAppSetting* vertical = FindSetting("Grid", "PrimSpaceV");
  ASSERT_EQ(Run({"set", "grid", spacing->control, "50mm", "--range", "3"}).code, kExitOk);
  std::vector<double> expected = spacing->defaults;
  expected[2] = 50.0; // only range 3
  EXPECT_EQ(Stored(spacing->repository, spacing->stored), expected);
  EXPECT_EQ(Run({"get", "grid", spacing->control, "--range", "3"}).out, "50 mm\n");
  EXPECT_NE(Run({"get", "grid", spacing->control}).out, "50 mm\n");

  // Vertical spacing follows the horizontal one until distortions are allowed for that range.
  EXPECT_TRUE(Says(Run({"set", "grid", vertical->control, "30mm"}), kExitRefused,
                   "disabled while \"Allow distortions\" is off"));
  EXPECT_TRUE(Has(Run({"show", "grid"}).out, "(disabled)"));
  ASSERT_EQ(Run({"set", "grid", "checkAllowDistortions", "on"}).code, kExitOk);
  ASSERT_EQ(Run({"set", "grid", vertical->control, "30mm"}).code, kExitOk);
  EXPECT_EQ(Stored(vertical->repository, vertical->stored)[0], 30.0);
  EXPECT_EQ(Run({"set", "grid", vertical->control, "30mm", "--range", "2"}).code, kExitRefused);

  // Reset puts every range back.
  ASSERT_EQ(Run({"reset", "grid", spacing->control}).code, kExitOk);
  EXPECT_FALSE(UserFile()["settings"][spacing->repository].contains(spacing->stored));
  ASSERT_EQ(Run({"reset", "--all"}).code, kExitOk);
  EXPECT_TRUE(UserFile()["settings"].empty());
}

TEST_F(AppCli, PaperUnitChangesWhatPaperLengthsShow) {
  const ZEPAppSetting* offset = FindSetting("PrimaryView", "DefaultOffsetBetViews");
  const double millimetres = offset->defaults[0];
  auto before = Shown(Run({"get", "primary-view", offset->control}).out);
  EXPECT_EQ(before.second, "mm");
  EXPECT_NEAR(before.first, millimetres, 5e-4);

  ASSERT_EQ(Run({"set", "general", "cmbPaperLengthUnit", "inch"}).code, kExitOk);
  auto after = Shown(Run({"get", "primary-view", offset->control}).out);
  EXPECT_EQ(after.second, "in");
  EXPECT_NEAR(after.first, millimetres / 25.4, 5e-4);
  // A plain number is now inches; the model lengths of the other pages stay in millimetres.
  ASSERT_EQ(Run({"set", "primary-view", offset->control, "2"}).code, kExitOk);
  EXPECT_NEAR(Stored(offset->repository, offset->stored)[0], 50.8, 1e-9);
  EXPECT_EQ(Shown(Run({"get", "general", "spinnerViewAxisSize"}).out).second, "mm");
}

TEST_F(AppCli, LockedSettingIsRefusedEverywhereAndShowsItsPadlock) {
  const ZEPAppSetting* unit = FindSetting("General", "PaperLengthUnit");
  ASSERT_EQ(Run({"set", "general", unit->control, "cm"}).code, kExitOk);
  ASSERT_TRUE(Says(Run({"lock", unit->stored}), kExitOk, ""));
  const std::string who = CurrentUserName();
  const std::string where = fs::absolute(_admin).lexically_normal().string();

  const std::string before = ReadBytes(_settings);
  for (const Args& args : {Args{"set", "general", unit->control, "mm"}, Args{"reset", "general", unit->control}})
    EXPECT_TRUE(Says(Run(args), kExitRefused, "Locked by " + who + " in " + where)) << args[0];
  EXPECT_EQ(ReadBytes(_settings), before);
  // Reset of everything keeps the locked setting at the administrator's value.
  ASSERT_EQ(Run({"reset", "--all"}).code, kExitOk);
  EXPECT_EQ(Run({"get", "general", unit->control}).out, "Centimetre (cm)\n");

  std::istringstream show(Run({"show", "general"}).out);
  std::string line, unitLine;
  while (std::getline(show, line))
    if (line.find(unit->control) != std::string::npos) unitLine = line;
  EXPECT_TRUE(Has(unitLine, "\xF0\x9F\x94\x92"));
  EXPECT_TRUE(Has(unitLine, who + " in " + where));

  const std::string html = Run({"render", "--html", "-", "general"}).out;
  const std::regex padlock("<span class=\"padlock (\\w+)\" data-name=\"" + unit->control + "Lock\" title=\"([^\"]*)\"");
  std::smatch m;
  ASSERT_TRUE(std::regex_search(html, m, padlock));
  EXPECT_EQ(m[1], "locked");
  EXPECT_TRUE(Has(m[2].str(), who));
  EXPECT_EQ(Count(html, "class=\"padlock locked\""), 2u); // this one and the legend's

  // Unlocked: the user may change it again; a second unlock changes nothing.
  ASSERT_EQ(Run({"unlock", unit->stored}).code, kExitOk);
  EXPECT_TRUE(Says(Run({"unlock", unit->stored}), kExitOk, "was not locked"));
  EXPECT_EQ(Run({"set", "general", unit->control, "mm"}).code, kExitOk);
  // Locking needs an administrator's file.
  EXPECT_EQ(Run({"--admin", "", "lock", unit->stored}).code, kExitUsage);
}

TEST_F(AppCli, FaultyFileIsReportedAndNeverWritten) {
  const std::string faulty = "{\n  \"format\": 1,\n  \"settings\": [\n";
  std::ofstream(_settings, std::ios::binary) << faulty;
  Result show = Run({"show", "general"});
  EXPECT_TRUE(Says(show, kExitOk, _settings + ":"));
  EXPECT_FALSE(show.out.empty());
  for (const Args& args :
       {Args{"set", "general", "checkViewFrame", "off"}, Args{"reset", "--all"}, Args{"lock", "DrwViewFrame"}})
    EXPECT_TRUE(Says(Run(args), kExitFile, _settings + ":")) << args[0];
  EXPECT_EQ(ReadBytes(_settings), faulty);
  EXPECT_FALSE(fs::exists(_admin));
}

TEST_F(AppCli, RenderIsOneSelfContainedDialog) {
  setenv("ZEP_TDE_LA", "1", 1); // every section of every page is drawn
  ASSERT_EQ(Run({"lock", "Drw_settings_GridDisplay"}).code, kExitOk);
  const fs::path file = _dir / "pages.html";
  ASSERT_TRUE(Says(Run({"render", "--html", file.string()}), kExitOk, ""));
  const std::string html = ReadBytes(file);
  for (const char* external : {"http:", "https:", "<link", "src=", "@import", "url(", "<script"})
    EXPECT_EQ(html.find(external), std::string::npos) << external;
  for (const ZEPAppPage& p : AppPages()) EXPECT_TRUE(Has(html, ">" + p.title + "<"));
  for (const std::string& title : CatalogTitles()) EXPECT_TRUE(Has(html, EscapeHtml(title)));
  // A padlock beside every lock-aware control of each page and its dialogs (a page embedded in
  // another shows its padlocks there too), and two in the legend; disabled ones greyed.
  // The standard combo keeps four settings under one padlock; the main page's add and remove
  // buttons keep none and are padlocked by the PLM lists' lock.
  std::size_t padlocks = 2 + 2;
  for (const ZEPAppPage& p : AppPages()) {
    std::set<std::string> controls;
    for (const ZEPAppSetting& s : AppSettings())
      if (p.Shows(s)) controls.insert(s.control);
    padlocks += controls.size();
  }
  EXPECT_EQ(Count(html, "class=\"padlock "), padlocks);
  EXPECT_TRUE(Has(html, "class=\"spinner disabled\" data-name=\"editorGridSpacingV_dialog\""));
  EXPECT_TRUE(Has(html, "class=\"check on disabled\" data-name=\"checkGrid_dialog\""));

  // Only the pages asked for.
  const std::string grid = Run({"render", "--html", "-", "grid"}).out;
  EXPECT_TRUE(Has(grid, "id=\"page-grid\""));
  EXPECT_EQ(grid.find("id=\"page-general\""), std::string::npos);
  EXPECT_EQ(Run({"render", "--html", "-", "nosuchpage"}).code, kExitUsage);
}

// ---- the binary --------------------------------------------------------------------------------
// Locks and refused values are the in-process tests' part; here only that the process ends with
// the code and writes where the run said, and that a script can trust its exit code.
TEST_F(AppCli, BinaryShowsSetsGetsAndRendersOnItsFiles) {
  Result r = RunBinary({}, false);
  ASSERT_EQ(r.code, 0) << r.err;
  for (const ZEPAppPage& p : AppPages()) EXPECT_TRUE(Has(r.out, p.title + "  [" + p.name + "]"));
  EXPECT_TRUE(Has(r.out, (_dir / ".config/drafting-options/settings.json").string()));
  EXPECT_FALSE(fs::exists(_dir / ".config")); // showing writes nothing
  EXPECT_EQ(RunBinary({"--version"}).out.find("drafting-options "), 0u);

  const ZEPAppSetting* spacing = FindSetting("Grid", "PrimSpaceH");
  ASSERT_TRUE(Says(RunBinary({"set", "grid", spacing->control, "2.5cm"}), 0, ""));
  EXPECT_EQ(Stored(spacing->repository, spacing->stored)[0], 25.0);
  EXPECT_EQ(RunBinary({"get", "grid", spacing->control}).out, "25 mm\n"); // a new run reads the file
  EXPECT_TRUE(Says(RunBinary({"set", "grid", "checkSnap", "sometimes"}), kExitBadValue, "on or off"));
  EXPECT_EQ(RunBinary({"render", "--html", (_dir / "out.html").string()}).code, 0);
  const std::string get = ShellQuote(ZEP_APP_BINARY) + " --settings " + ShellQuote(_settings) + " get DrwViewFrame";
  EXPECT_EQ(WEXITSTATUS(std::system((get + " > /dev/full 2>/dev/null").c_str())), kExitFailure);
  EXPECT_EQ(WEXITSTATUS(std::system((get + " > /dev/null").c_str())), kExitOk);
}

TEST_F(AppCli, SubDialogControlsAreSetThroughTheirDialog) {
  // A radio group by its text, its line number or a radio's name; checks of the other dialogs.
  Result drag = Run({"set", "geometry", "frameDragMode", "relaxation"});
  ASSERT_EQ(drag.code, kExitOk) << drag.err;
  EXPECT_EQ(drag.out, "Solving mode: Relaxation\n");
  EXPECT_EQ(Stored("DrwSketcherGeneral", "Drw_settings_DragModeR14"), std::vector<double>{2});
  EXPECT_EQ(Run({"set", "geometry", "frameDragMode", "radioDragModeStd"}).code, kExitOk);
  EXPECT_EQ(Run({"get", "geometry", "frameDragMode"}).out, "Standard mode\n");
  EXPECT_EQ(Run({"set", "geometry", "frameDragMode", "3"}).code, kExitOk); // the third choice
  EXPECT_EQ(Run({"set", "geometry", "checkSmartPickHoriVerti", "off"}).code, kExitOk);
  EXPECT_EQ(Run({"set", "geometry", "checkCstVisuSym", "off"}).code, kExitOk);
  EXPECT_EQ(Stored("DrwSketcherGeneral", "Drw_settings_CpltDirHorVert"), std::vector<double>{0});
  EXPECT_EQ(Stored("DraftingOptions", "DrwGeoCstVisuSym"), std::vector<double>{0});
  // The sketcher reads what the geometry page wrote.
  const std::string sketcher = Run({"sketcher"}).out;
  EXPECT_TRUE(std::regex_search(sketcher, std::regex(R"(mode\s+2\n)"))) << sketcher;
  EXPECT_TRUE(std::regex_search(sketcher, std::regex(R"(horizontal/vertical direction\s+off)"))) << sketcher;
  // show lists the dialog's controls under it.
  const std::string shown = Run({"show", "geometry"}).out;
  const auto dialog = shown.find("Solving Mode (dialog of \"Solving Mode...\")");
  ASSERT_NE(dialog, std::string::npos) << shown;
  EXPECT_GT(shown.find("frameDragMode"), dialog);
  EXPECT_TRUE(Has(shown, "Relaxation"));

  EXPECT_TRUE(Says(Run({"set", "geometry", "frameDragMode", "fastest"}), kExitBadValue, "3  Relaxation"));
  EXPECT_TRUE(Says(Run({"set", "geometry", "dragOptionPushButton", "on"}), kExitUsage, "opens a dialog"));
}

TEST_F(AppCli, SubDialogsFollowTheirButtonAndTheirLocks) {
  ASSERT_EQ(Run({"set", "geometry", "checkGeomDrag", "off"}).code, kExitOk);
  EXPECT_TRUE(Says(Run({"set", "geometry", "checkDragWithEndPts", "off"}), kExitUsage,
                   "\"Solving Mode...\" is disabled while \"Allow direct manipulation\" is off"));
  ASSERT_EQ(Run({"set", "geometry", "checkGeomDrag", "on"}).code, kExitOk);
  ASSERT_EQ(Run({"lock", "Drw_settings_DragModeR14"}).code, kExitOk);
  EXPECT_TRUE(
      Says(Run({"set", "geometry", "frameDragMode", "relaxation"}), kExitRefused, "\"Solving mode\" is locked"));
  EXPECT_EQ(Run({"set", "geometry", "checkDragWithEndPts", "off"}).code, kExitOk);
  // The reference size and colour follow "Display constraints".
  ASSERT_EQ(Run({"set", "geometry", "checkCstVisu", "off"}).code, kExitOk);
  EXPECT_TRUE(Says(Run({"set", "geometry", "comboCstColor", "red"}), kExitRefused,
                   "turn \"Display constraints\" (checkCstVisu) on first"));
}

TEST_F(AppCli, GeometryPageShowsTheGridPageSettings) {
  ASSERT_EQ(Run({"set", "geometry", "editorGridSpacing", "20mm", "--range", "2"}).code, kExitOk);
  EXPECT_EQ(Shown(Run({"get", "grid", "editorGridSpacing", "--range", "2"}).out),
            std::make_pair(20.0, std::string("mm")));
  ASSERT_EQ(Run({"set", "grid", "checkSnap", "off"}).code, kExitOk);
  EXPECT_EQ(Run({"get", "geometry", "checkSnap"}).out, "off\n");
  EXPECT_EQ(Run({"reset", "geometry", "checkSnap"}).code, kExitOk);
  EXPECT_EQ(Run({"get", "grid", "checkSnap"}).out, "on\n");
}

TEST_F(AppCli, DimensionPageWithItsAssociativityDialog) {
  ASSERT_EQ(Run({"set", "dimension", "_frameDimForce2D", "always"}).code, kExitOk);
  EXPECT_EQ(Stored("DraftingOptions", "DrwDimAssoc3DMod"), std::vector<double>{2});
  EXPECT_EQ(Run({"set", "dimension", "chkAssocDimOnApproximate", "on"}).code, kExitOk);
  EXPECT_EQ(Run({"set", "dimension", "_frameDimCircleRadio", "2"}).code, kExitOk);
  EXPECT_EQ(Stored("DraftingOptions", "DrwDimCreateCircle"), std::vector<double>{1});
  // Angles in degrees at the store, whatever the user typed.
  EXPECT_EQ(Run({"set", "dimension", "_editorLineUpOffsetAngle", "0.5rad"}).code, kExitOk);
  EXPECT_NEAR(Stored("DraftingOptions", "DrwDimOffsetBetDeg")[0], 28.6479, 1e-3);
  // The line position follows the cursor rule the other way round.
  EXPECT_TRUE(Says(Run({"set", "dimension", "editorDimLinePosValue", "5mm"}), kExitRefused,
                   "is on; turn \"Dimension follows the cursor\" (checkDimSketch) off first"));
  ASSERT_EQ(Run({"set", "dimension", "checkDimSketch", "off"}).code, kExitOk);
  EXPECT_EQ(Run({"set", "dimension", "editorDimLinePosValue", "5mm"}).code, kExitOk);
  EXPECT_EQ(Stored("DraftingOptions", "DrwDimConstantOffsetValue"), std::vector<double>{5});
}

// ---- manipulators and administration pages --------------------------------------------------
TEST_F(AppCli, ManipulatorMatrixCellsAndTransparency) {
  const Result show = Run({"show", "manipulators"});
  EXPECT_TRUE(Says(show, kExitOk, "Change symbol / Modification"));
  EXPECT_TRUE(Has(show.out, "Move datum / Edition"));
  ASSERT_EQ(Run({"set", "manipulators", "_checkDimChangeSymbolMod", "off"}).code, kExitOk);
  EXPECT_EQ(Stored("DraftingOptions", "DrwManipDimChangeSymbolMod"), std::vector<double>{0});
  EXPECT_EQ(Run({"get", "manipulators", "_checkDimChangeSymbolCre"}).out, "on\n");
  // A percentage is kept as the user typed it.
  ASSERT_EQ(Run({"set", "manipulators", "editorManipTransparency", "29"}).code, kExitOk);
  EXPECT_EQ(Stored("DraftingOptions", "DrwManipTransparency"), std::vector<double>{29});
  EXPECT_EQ(Run({"get", "manipulators", "editorManipTransparency"}).out, "29 %\n");
  EXPECT_EQ(Run({"set", "manipulators", "editorManipTransparency", "150"}).code, kExitBadValue);
}

TEST_F(AppCli, AdministrationRulesAreExplained) {
  ASSERT_EQ(Run({"set", "administration", "frmSelectionOnCurrentAssembly", "1"}).code, kExitOk);
  EXPECT_EQ(Stored("DraftingOptions", "DrwSelectionOnCurrentAssembly"), std::vector<double>{0});
  EXPECT_TRUE(Says(Run({"set", "administration", "chkShowWarningSelectionOutAssembly", "off"}), kExitRefused,
                   "is disabled while \"Selection scope\" is \"Elements under the current assembly "
                   "root\"; choose"));
  ASSERT_EQ(Run({"set", "administration", "frmSelectionOnCurrentAssembly", "3"}).code, kExitOk);
  ASSERT_EQ(Run({"set", "administration", "chkShowWarningSelectionOutAssembly", "on"}).code, kExitOk);
  EXPECT_TRUE(Says(Run({"set", "administration", "chkShowWarningSelectionOutFavoriteContext", "off"}), kExitRefused,
                   "while \"Outside the current assembly\" is on"));
  // Distinguishing needs one unique-name check; the view name scope needs the view names one.
  for (const char* name : {"checkSheetNamesUnicity", "checkViewNamesUnicity"})
    ASSERT_EQ(Run({"set", "administration", name, "off"}).code, kExitOk);
  EXPECT_TRUE(Says(Run({"set", "administration", "chkDistinguishCodeInUnicity", "on"}), kExitRefused,
                   "while all of these are off; turn \"Sheet names must be unique\""));
  EXPECT_TRUE(Says(Run({"set", "administration", "frmViewNameUnicityScope", "2"}), kExitRefused,
                   "turn \"View names must be unique\" (checkViewNamesUnicity) on"));
  ASSERT_EQ(Run({"set", "administration", "chkCaptureNamesUnicity", "on"}).code, kExitOk);
  EXPECT_EQ(Run({"set", "administration", "chkDistinguishCodeInUnicity", "on"}).code, kExitOk);
}

TEST_F(AppCli, BehaviorDialogRowsAreSetThroughTheirLines) {
  const Result show = Run({"show", "administration"});
  EXPECT_TRUE(Says(show, kExitOk, "cmbDrwTbFontName"));
  EXPECT_TRUE(Has(show.out, "cmbDrwTbPattern"));
  ASSERT_EQ(Run({"set", "administration", "cmbDrwTbFrame", "no override"}).code, kExitOk);
  EXPECT_EQ(Stored("DraftingOptions", "DrwTbFrame"), std::vector<double>{3});
  ASSERT_EQ(Run({"set", "administration", "cmbDrwTbPattern", "fixed"}).code, kExitOk);
  EXPECT_EQ(Stored("DraftingOptions", "DrwTbPattern"), std::vector<double>{0});
  EXPECT_EQ(Run({"get", "administration", "cmbDrwTbPattern"}).out, "Fixed\n");
  // The dialog's place is among the user's preferences.
  EXPECT_TRUE(Has(ReadBytes(_settings), "dlgPropTbBehaviorHeight"));
}

// ---- annotation and display pages ----------------------------------------------------------------
TEST_F(AppCli, DisplayColoursAreTypedAsNumbersHexOrLines) {
  const struct {
    const char* value;
    const char* shown;
  } cases[] = {
      {"10 20 30", "RGB 10,20,30"}, {"#FF8000", "RGB 255,128,0"}, {"red", "Red"}, {"3", "Red"}, {"0,0,255", "Blue"}};
  for (const auto& c : cases) {
    ASSERT_TRUE(Says(Run({"set", "display", "cmbCappingColor", c.value}), kExitOk, "")) << c.value;
    EXPECT_EQ(Run({"get", "display", "cmbCappingColor"}).out, std::string(c.shown) + "\n");
  }
  for (const char* bad : {"256 0 0", "#GG0000", "1 2", "chartreuse"})
    EXPECT_EQ(Run({"set", "display", "cmbCappingColor", bad}).code, kExitBadValue) << bad;
  // The diagnosis colours are the sketcher's: it reads what the page wrote.
  ASSERT_EQ(Run({"set", "display", "cmbOverConsElts", "1 2 3"}).code, kExitOk);
  EXPECT_TRUE(Has(Run({"sketcher"}).out, "1 2 3 (#010203)"));
  // A state's colour and the contour weight wait for their check box.
  EXPECT_TRUE(Says(Run({"set", "display", "cmbDimTrue", "red"}), kExitRefused, "(chkDimTrue) on first"));
  ASSERT_EQ(Run({"set", "display", "chkPatternContourPitch", "on"}).code, kExitOk);
  ASSERT_EQ(Run({"set", "display", "cmbPatternContourPitch", "3"}).code, kExitOk);
  EXPECT_EQ(Run({"get", "display", "cmbPatternContourPitch"}).out, "Weight 3\n");
}

TEST_F(AppCli, NewerDialogsOpenAndEndEveryWayLeavingThePageOperable) {
  for (const char* page : {"annotation", "callouts"})
    for (const char* action : {"accept", "cancel", "reject"})
      EXPECT_TRUE(Says(Run({"set", page, "pushLegendTableLayout", action}), kExitOk, " and closed")) << page;
  EXPECT_TRUE(Says(Run({"set", "annotation", "pushTableSortCustomLists", "accept"}), kExitOk, "\"Months\""));
  EXPECT_EQ(Run({"set", "annotation", "pushTableSortCustomLists", "open"}).code, kExitOk);
  EXPECT_EQ(Run({"set", "annotation", "pushTableSortCustomLists", "press"}).code, kExitBadValue);
  EXPECT_EQ(Run({"set", "callouts", "pushTableSortCustomLists", "open"}).code, kExitUsage);
}

// ---- one key per setting, the administrator's commands, JSON, round trips ------------------------
TEST_F(AppCli, EveryKeyFormNamesTheSameSetting) {
  for (const Args& key : {Args{"general", "checkViewFrame"}, Args{"general.checkViewFrame"}, Args{"DrwViewFrame"}}) {
    Args set = {"set"}, get = {"get"};
    set.insert(set.end(), key.begin(), key.end());
    get.insert(get.end(), key.begin(), key.end());
    const bool on = Run(get).out == "on\n";
    set.push_back(on ? "off" : "on");
    ASSERT_EQ(Run(set).code, kExitOk) << key[0];
    EXPECT_EQ(Stored("DraftingOptions", "DrwViewFrame"), std::vector<double>{on ? 0.0 : 1.0}) << key[0];
  }
  // reset, lock and unlock take every form too.
  EXPECT_EQ(Run({"reset", "DrwViewFrame"}).code, kExitOk);
  EXPECT_EQ(Run({"lock", "general", "cmbPaperLengthUnit"}).code, kExitOk);
  EXPECT_EQ(Run({"set", "general.cmbPaperLengthUnit", "inch"}).code, kExitRefused);
  EXPECT_EQ(Run({"unlock", "general.cmbPaperLengthUnit"}).code, kExitOk);
  EXPECT_EQ(Run({"set", "DrwPaperLengthUnit", "inch"}).code, kExitOk);
  // show names the attribute beside each control.
  EXPECT_TRUE(std::regex_search(Run({"show", "general"}).out, std::regex(R"(checkViewFrame .* DrwViewFrame)")));
  EXPECT_EQ(Run({"get", "general.nosuch"}).code, kExitUsage);
  EXPECT_EQ(Run({"set", "DrwViewFrame"}).code, kExitUsage); // the value is missing
}

TEST_F(AppCli, AdministratorLocksAtAValueAndSetsDefaultsWithoutCodes) {
  ASSERT_EQ(Run({"set", "general", "cmbPaperLengthUnit", "cm"}).code, kExitOk);
  ASSERT_TRUE(Says(Run({"lock", "general", "cmbPaperLengthUnit", "inch"}), kExitOk, ""));
  const nlohmann::json admin = nlohmann::json::parse(ReadBytes(_admin));
  const nlohmann::json& entry = admin["settings"]["DraftingOptions"]["DrwPaperLengthUnit"];
  EXPECT_EQ(entry["int"], 5);
  EXPECT_EQ(entry["locked"], true);
  EXPECT_EQ(Stored("DraftingOptions", "DrwPaperLengthUnit"), std::vector<double>{3}) << "the user's file is left";
  EXPECT_EQ(Run({"get", "DrwPaperLengthUnit"}).out, "Inch (in)\n");
  // A new value for a lock, in the unit the control shows.
  ASSERT_EQ(Run({"lock", "general.spinnerViewAxisSize", "2cm"}).code, kExitOk);
  ASSERT_EQ(Run({"lock", "general.spinnerViewAxisSize", "3cm"}).code, kExitOk);
  EXPECT_EQ(Run({"get", "general.spinnerViewAxisSize", "--raw"}).out, "30\n");
  EXPECT_EQ(Run({"lock", "general.spinnerViewAxisSize", "-5cm"}).code, kExitBadValue);
  // A default for everyone that the user may still change.
  ASSERT_EQ(Run({"default", "general.checkViewFrame", "off"}).code, kExitOk);
  EXPECT_EQ(Run({"get", "DrwViewFrame"}).out, "off\n");
  EXPECT_EQ(Run({"set", "DrwViewFrame", "on"}).code, kExitOk);
  EXPECT_EQ(Run({"default", "--remove", "DrwPaperLengthUnit"}).code, kExitFile); // locked: unlock first
  const nlohmann::json locks = nlohmann::json::parse(Run({"locks", "--json"}).out);
  ASSERT_EQ(locks.size(), 3u);
  for (const auto& l : locks) {
    const bool locked = l["attribute"] != "DrwViewFrame";
    EXPECT_EQ(l["locked"], locked) << l.dump();
    EXPECT_EQ(l["by"], locked ? CurrentUserName() : "") << l.dump();
    EXPECT_FALSE(l["key"].is_null());
  }
  ASSERT_EQ(Run({"default", "--remove", "DrwViewFrame"}).code, kExitOk);
  EXPECT_EQ(Run({"default", "--remove", "DrwViewFrame"}).out, "DrwViewFrame had no default; nothing changed\n");
  EXPECT_EQ(nlohmann::json::parse(Run({"locks", "--json"}).out).size(), 2u);
}

TEST_F(AppCli, JsonOutputsDescribeEverySetting) {
  const nlohmann::json pages = nlohmann::json::parse(Run({"pages", "--json"}).out);
  ASSERT_EQ(pages.size(), AppPages().size());
  const nlohmann::json grid = nlohmann::json::parse(Run({"show", "grid", "--json", "--range", "2"}).out);
  EXPECT_EQ(grid["range"], 2);
  const nlohmann::json& controls = grid["controls"];
  const auto v =
      std::find_if(controls.begin(), controls.end(), [](auto& c) { return c["control"] == "editorGridSpacingV"; });
  ASSERT_NE(v, controls.end());
  EXPECT_EQ((*v)["enabled"], false);
  EXPECT_TRUE(Has((*v)["whyNot"].get<std::string>(), "checkAllowDistortions"));
  EXPECT_EQ((*v)["attribute"], "Drw_settings_GridVPrimarySpacing");
  EXPECT_EQ((*v)["stored"].size(), 5u);
  const nlohmann::json one = nlohmann::json::parse(Run({"get", "DrwPaperLengthUnit", "--json"}).out);
  EXPECT_EQ(one["key"], "general.cmbPaperLengthUnit");
  EXPECT_EQ(one["stored"], nlohmann::json::array({1}));
  // list: every stored setting once, on its own page.
  const nlohmann::json all = nlohmann::json::parse(Run({"list", "--json"}).out);
  std::set<std::string> listed;
  for (const auto& s : all) listed.insert(s["attribute"].get<std::string>());
  EXPECT_EQ(listed.size(), all.size());
  EXPECT_TRUE(listed.count("DrwViewFrame") && listed.count("Drw_settings_DragModeR14"));
  EXPECT_GT(all.size(), 200u);
}

TEST_F(AppCli, WhatGetPrintsSetsBackWithoutChange) {
  // Every spinner of every page, in each paper unit: typing back what get prints changes nothing.
  int checked = 0;
  for (const char* unit : {"mm", "cm", "inch"}) {
    ASSERT_EQ(Run({"set", "general", "cmbPaperLengthUnit", unit}).code, kExitOk);
    for (const ZEPAppPage& page : AppPages()) {
      const nlohmann::json shown = nlohmann::json::parse(Run({"show", page.name, "--json"}).out);
      for (const auto& c : shown["controls"]) {
        if (c["kind"] != "spinner" || !c["enabled"].get<bool>()) continue;
        const std::string key = page.name + "." + c["control"].get<std::string>();
        const std::string value = Run({"get", key}).out;
        const std::string before = ReadBytes(_settings);
        EXPECT_TRUE(Says(Run({"set", key, value.substr(0, value.size() - 1)}), kExitOk, "(unchanged)")) << key;
        EXPECT_EQ(ReadBytes(_settings), before) << key;
        ++checked;
      }
    }
  }
  EXPECT_GT(checked, 30);
}

TEST_F(AppCli, CompletionScriptAndHelpForScripts) {
  // A completion script that bash reads, knowing the pages and the controls.
  const std::string script = Run({"completion", "bash"}).out;
  EXPECT_TRUE(Has(script, "complete -F _drafting_options drafting-options"));
  EXPECT_TRUE(Has(script, "general.checkViewFrame"));
  std::ofstream(_dir / "completion.bash") << script;
  EXPECT_EQ(std::system(("bash -n '" + (_dir / "completion.bash").string() + "'").c_str()), 0);
  // Each command's help has examples; the program's help the exit codes.
  EXPECT_TRUE(Has(Run({"set", "--help"}).out, "Examples:"));
  EXPECT_TRUE(Has(Run({"--help"}).out, "Exit codes:"));
}

TEST_F(AppCli, RenderedDialogExplainsGreyControlsAndOpensTheAskedTab) {
  ASSERT_EQ(Run({"lock", "DrwViewFrame"}).code, kExitOk);
  const std::string html = Run({"render", "--html", "-", "general", "grid", "--range", "3"}).out;
  // Tooltips: who locked it, and which control keeps another disabled.
  EXPECT_TRUE(std::regex_search(
      html, std::regex("data-name=\"checkViewFrame_dialog\" title=\"[^\"]*Locked by " + CurrentUserName())))
      << "locked control without its reason";
  EXPECT_TRUE(std::regex_search(
      html, std::regex("data-name=\"editorGridSpacingV_dialog\" title=\"[^\"]*turn &quot;Allow distortions&quot;")));
  EXPECT_TRUE(Has(html, "<span class=\"label\">Scale range:</span>"));
  EXPECT_TRUE(Has(html, "1\u202F000\u202F000 mm"));   // grouped for reading
  EXPECT_TRUE(Has(html, ".panels .page:target")); // #page-NAME opens it
  EXPECT_TRUE(Has(html, "overflow:auto"));        // scrolls when narrow
  // Without its catalogs the program stops at once rather than drawing a dialog without texts.
  setenv("ZEP_RESOURCES", (_dir / "nowhere").c_str(), 1);
  Result missing = Run({"render", "--html", "-"});
  unsetenv("ZEP_RESOURCES");
  EXPECT_EQ(missing.code, kExitFailure);
  EXPECT_TRUE(Has(missing.err, (_dir / "nowhere").string() + "/catalogs"));
  EXPECT_TRUE(missing.out.empty());
}

// ---- the main page: standards and scale ratios -----------------------------------------------
// Every change is a run of its own: what the next run shows is what the file kept.
TEST_F(AppCli, MainPageStandardsSurviveEachSaveAndReload) {
  const std::string plm = (_dir / "plm.json").string();
  std::ofstream(plm) << R"({"standards": [
    {"name": "Soci\u00e9t\u00e9 \u6a19\u6e96", "key": "K-1"},
    {"name": "Twin", "key": "K-2"}, {"name": "Twin", "key": "K-3", "unicity": 0},
    {"name": "Unsure", "key": "K-4", "unicity": -1}]})";
  auto run = [&](std::vector<std::string> iArgs) {
    iArgs.insert(iArgs.begin(), {"--plm-repository", plm});
    return Run(iArgs);
  };
  // A text or a list of texts of the user's file (a list of one is kept as one text).
  auto texts = [&](const char* iAttribute) {
    const nlohmann::json value = UserFile()["settings"]["DraftingOptions"][iAttribute]["text"];
    return value.is_array() ? value.get<std::vector<std::string>>() : std::vector<std::string>{value};
  };
  using Texts = std::vector<std::string>;
  const std::string societe = "Soci\xC3\xA9t\xC3\xA9 \xE6\xA8\x99\xE6\xBA\x96";

  ASSERT_EQ(run({"set", "main", "cmbStandardName", "JIS"}).code, kExitOk);
  EXPECT_EQ(texts("DrwStandardName"), Texts{"JIS"});
  // Added through the chooser by name or key; the last one added is current.
  for (const std::string& wanted : {societe, std::string("K-3"), std::string("K-2")})
    ASSERT_EQ(run({"set", "main", "pusStandardPLMAdd", wanted}).code, kExitOk) << wanted;
  EXPECT_EQ(texts("DrwStandardPLMList"), (Texts{societe, "Twin", "Twin"}));
  EXPECT_EQ(texts("DrwStandardPLMIDList"), (Texts{"K-1", "K-3", "K-2"}));
  EXPECT_EQ(texts("DrwStandardName"), Texts{"K-2"});
  EXPECT_EQ(Stored("DraftingOptions", "DrwIsStandardPLM"), std::vector<double>{1});
  const struct {
    const char* control;
    const char* value;
    int code;
    const char* told;
  } refused[] = {
      {"pusStandardPLMAdd", "Twin", kExitBadValue, "keys K-2, K-3"},
      {"pusStandardPLMAdd", "Nobody", kExitBadValue, "Unsure  (key K-4)"},
      {"pusStandardPLMAdd", "K-4", kExitBadValue, "does not guarantee the key K-4"},
      {"pusStandardPLMAdd", "K-1", kExitOk, "listed already"},
      {"cmbStandardName", "Twin", kExitBadValue, "(PLM standard, key K-3)"},
      {"pusStandardPLMRemove", "K-9", kExitBadValue, "Twin  (key K-2)"},
  };
  const std::string before = ReadBytes(_settings);
  for (const auto& r : refused) EXPECT_TRUE(Says(run({"set", "main", r.control, r.value}), r.code, r.told)) << r.value;
  EXPECT_EQ(ReadBytes(_settings), before);

  // Two standards of one name: each line is its own, by its key.
  ASSERT_EQ(run({"set", "main", "cmbStandardName", "K-3"}).code, kExitOk);
  EXPECT_EQ(texts("DrwStandardName"), Texts{"K-3"});
  EXPECT_EQ(run({"get", "main", "cmbStandardName"}).out, "Twin\n");
  EXPECT_EQ(run({"get", "DrwStandardName", "--raw"}).out, "K-3\n");
  // Removing another keeps the current standard; removing the current one brings the default.
  ASSERT_EQ(run({"set", "main", "pusStandardPLMRemove", "K-2"}).code, kExitOk);
  EXPECT_EQ(texts("DrwStandardName"), Texts{"K-3"});
  ASSERT_EQ(run({"set", "main", "pusStandardPLMRemove", "Twin"}).code, kExitOk);
  EXPECT_EQ(texts("DrwStandardName"), Texts{"ISO"});
  EXPECT_EQ(Stored("DraftingOptions", "DrwIsStandardPLM"), std::vector<double>{0});
  EXPECT_EQ(texts("DrwStandardPLMList"), Texts{societe});
  EXPECT_EQ(texts("DrwStandardPLMIDList"), Texts{"K-1"});

  // JSON: one text as a string, a list as an array of strings.
  const nlohmann::json name = nlohmann::json::parse(run({"get", "DrwStandardName", "--json"}).out);
  EXPECT_EQ(name["stored"], "ISO");
  EXPECT_EQ(name["kind"], "combo");
  std::map<std::string, nlohmann::json> listed;
  for (const auto& s : nlohmann::json::parse(run({"list", "--json"}).out))
    if (s["page"] == "main") listed[s["attribute"]] = s["stored"];
  EXPECT_EQ(listed["DrwStandardPLMList"], nlohmann::json::array({societe}));
  EXPECT_EQ(listed["DrwStandardPLMIDList"], nlohmann::json::array({"K-1"}));

  // The standard combo's settings are locked together: no PLM standard can be added then.
  ASSERT_EQ(run({"lock", "main", "cmbStandardName", "JIS"}).code, kExitOk);
  const nlohmann::json admin = nlohmann::json::parse(ReadBytes(_admin))["settings"]["DraftingOptions"];
  EXPECT_EQ(admin["DrwStandardName"]["text"], "JIS");
  EXPECT_EQ(admin["DrwStandardPLMIDList"]["locked"], true);
  EXPECT_EQ(run({"get", "main", "cmbStandardName"}).out, "JIS\n");
  EXPECT_EQ(run({"set", "main", "pusStandardPLMAdd", "K-2"}).code, kExitRefused);
  EXPECT_EQ(run({"set", "main", "pusStandardPLMRemove", "K-1"}).code, kExitRefused);
  EXPECT_EQ(nlohmann::json::parse(run({"locks", "--json"}).out).size(), 4u);
  ASSERT_EQ(run({"unlock", "DrwStandardName"}).code, kExitOk);
  EXPECT_TRUE(nlohmann::json::parse(run({"locks", "--json"}).out)[0]["locked"] == false);
}

TEST_F(AppCli, ScaleRatiosPerRangeAndTheTitleBlockFolder) {
  ASSERT_EQ(Run({"set", "main", "edtScaleRatio", "1:50"}).code, kExitOk);
  ASSERT_EQ(Run({"set", "main", "edtScaleRatio", "50", "--range", "2"}).code, kExitOk);
  std::vector<double> ratios = FindSetting("Main", "ScaleRatio")->defaults;
  ratios[0] = 0.02;
  ratios[1] = 50;
  EXPECT_EQ(Stored("DraftingOptions", "DrwScaleRatio"), ratios);
  EXPECT_EQ(Run({"get", "main", "edtScaleRatio"}).out, "1:50\n");
  EXPECT_EQ(Run({"get", "main", "edtScaleRatio", "--range", "2"}).out, "50:1\n");
  EXPECT_EQ(Run({"get", "main", "edtScaleRatioDec"}).out, "0.02\n");
  EXPECT_EQ(Run({"set", "main", "edtScaleRatio", "1/50"}).out,
            "Scale ratio: 1:50 (unchanged)  (scale range 1: Normal)\n");
  const std::string before = ReadBytes(_settings);
  const struct {
    std::vector<std::string> args;
    const char* told;
  } refused[] = {{{"abc"}, "not a scale ratio"}, {{"0"}, "not a scale ratio"},
                 {{"1:50", "--range", "2"}, "from 0.1 to 100000"}, {{"1:5000"}, "outside the limits"}};
  for (const auto& r : refused) {
    Args args = {"set", "main", "edtScaleRatio"};
    args.insert(args.end(), r.args.begin(), r.args.end());
    EXPECT_TRUE(Says(Run(args), kExitBadValue, r.told));
  }
  EXPECT_TRUE(Says(Run({"set", "main", "edtScaleRatioDec", "3"}), kExitRefused, "set edtScaleRatio instead"));
  EXPECT_TRUE(Says(Run({"set", "main", "chkMakeDrawingShareable", "on"}), kExitRefused, "(chkInsertDrawing) on first"));

  // The folder: a text kept as typed; a folder this computer lacks is only warned about.
  const std::string folder = (_dir / "Cartouches \xC3\xA9t\xC3\xA9").string();
  fs::create_directories(folder);
  Result set = Run({"set", "administration", "FrameAndTitleBlockPath", folder});
  ASSERT_EQ(set.code, kExitOk) << set.err;
  EXPECT_TRUE(set.err.empty()) << set.err;
  EXPECT_EQ(Run({"get", "DrwFolderTitleBlock"}).out, folder + "\n");
  EXPECT_TRUE(Says(Run({"set", "administration", "FrameAndTitleBlockPath", "/no/such/folder"}), kExitOk,
                   "warning: there is no folder \"/no/such/folder\""));
  EXPECT_EQ(nlohmann::json::parse(Run({"get", "DrwFolderTitleBlock", "--json"}).out)["stored"], "/no/such/folder");
  const std::string kept = ReadBytes(_settings);
  for (const char* bad : {"", "  ", "bad \xC3", "two\nlines"})
    EXPECT_EQ(Run({"set", "administration", "FrameAndTitleBlockPath", bad}).code, kExitBadValue) << bad;
  EXPECT_EQ(ReadBytes(_settings), kept);
  ASSERT_EQ(Run({"reset", "DrwFolderTitleBlock"}).code, kExitOk);
  EXPECT_EQ(Run({"get", "DrwFolderTitleBlock"}).out, "\n");
  // The administrator locks it at a text.
  ASSERT_EQ(Run({"lock", "administration", "FrameAndTitleBlockPath", folder}).code, kExitOk);
  EXPECT_EQ(nlohmann::json::parse(Run({"locks", "--json"}).out)[0]["value"], folder);
  EXPECT_EQ(Run({"set", "DrwFolderTitleBlock", "/elsewhere"}).code, kExitRefused);
}

TEST_F(AppCli, StandardsFolderAndAFaultyPLMRepository) {
  const fs::path standards = _dir / "standards";
  fs::create_directories(standards / "drafting");
  for (const char* file : {"Shop.xml", "readme.txt", "Yard.XML"})
    std::ofstream(standards / "drafting" / file) << "<x/>";
  setenv("DRAFTING_OPTIONS_STANDARDS", standards.c_str(), 1);
  Result chosen = Run({"set", "main", "cmbStandardName", "yard"});
  unsetenv("DRAFTING_OPTIONS_STANDARDS");
  ASSERT_EQ(chosen.code, kExitOk) << chosen.err;
  EXPECT_EQ(chosen.out, "Drafting standard: Yard\n");
  // Among the samples "Yard" is no choice: shown as an extra first line, the others after it.
  EXPECT_TRUE(Has(Run({"set", "main", "cmbStandardName", "1"}).out, "Yard (not offered) (unchanged)"));
  EXPECT_EQ(Run({"set", "main", "cmbStandardName", "2"}).out, "Drafting standard: ANSI\n");
  EXPECT_TRUE(Says(Run({"--standards", (_dir / "none").string(), "get", "main", "cmbStandardName"}), kExitOk,
                   "no folder standard is offered"));

  // A repository file the chooser cannot use: said where, and nothing is written.
  const std::string plm = (_dir / "plm.json").string();
  const std::string before = ReadBytes(_settings);
  const struct {
    const char* text;
    const char* told;
  } faulty[] = {
      {"{\"standards\": [", ":1:16: not JSON"},
      {"{\"standards\": {}}", ":1:15: \"standards\" must be an array"},
      {"{\"standards\": [{\"name\": \"A\"}]}", ":1:16: this standard has no \"key\""},
      {"{\"standards\": [{\"name\": \"A\", \"key\": \"k\"},\n {\"name\": \"B\", \"key\": \"k\"}]}",
       ":2:23: the key \"k\" is given twice"},
      {"{\"standards\": [{\"name\": \"A\", \"key\": \"k\", \"owner\": 1}]}", ":1:42: unknown member \"owner\""},
      {"{\"standards\": [{\"name\": \"A\", \"key\": \"k\", \"unicity\": \"high\"}]}",
       ":1:53: \"unicity\" must be a whole number"},
      {"{\"standards\": [{\"name\": \"A\\nB\", \"key\": \"k\"}]}", ":1:25: \"name\" must be a text that is not empty"},
  };
  for (const auto& f : faulty) {
    std::ofstream(plm, std::ios::binary | std::ios::trunc) << f.text;
    EXPECT_TRUE(Says(Run({"--plm-repository", plm, "set", "main", "pusStandardPLMAdd", "A"}), kExitFile, plm + f.told));
  }
  EXPECT_EQ(Run({"--plm-repository", _dir.string(), "set", "main", "pusStandardPLMAdd", "A"}).code, kExitFile);
  EXPECT_EQ(ReadBytes(_settings), before);
  // Names and keys that do not pair up (a file edited by hand) are pointed out.
  std::ofstream(_settings, std::ios::trunc)
      << R"({"settings": {"DraftingOptions": {"DrwStandardPLMList": {"text": ["A", "B"]},
                                               "DrwStandardPLMIDList": {"text": "k"}}}})";
  EXPECT_TRUE(Has(Run({"get", "main", "cmbStandardName"}).err, "holds 2 names and DrwStandardPLMIDList 1 keys"));
  // The standard's name is one text, not a list.
  std::ofstream(_settings, std::ios::trunc)
      << R"({"settings": {"DraftingOptions": {"DrwStandardName": {"text": ["JIS", "ANSI"]}}}})";
  Result two = Run({"get", "main", "cmbStandardName"});
  EXPECT_EQ(two.out, "ISO\n");
  EXPECT_TRUE(Has(two.err, "holds 2 values, expected 1"));
  fs::remove(_settings);
  // The shipped sample is found like the catalogs, and lists the standards the chooser offers.
  EXPECT_TRUE(Says(Run({"set", "main", "pusStandardPLMAdd", "Supplier drafting standard"}), kExitOk, ""));
  // The rendered combo tells PLM lines from folder lines.
  const std::string html = Run({"render", "--html", "-", "main"}).out;
  EXPECT_TRUE(Has(html, "data-icon=\"I_D3M_Database\""));
  EXPECT_TRUE(Has(html, "ISO (standard file)"));
  EXPECT_TRUE(Has(html, "Supplier drafting standard (PLM standard)"));
}
