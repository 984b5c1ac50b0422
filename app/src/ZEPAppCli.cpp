#include "ZEPAppCli.h"

#include "ZEPAppInfo.h"
#include "ZEPAppKeys.h"
#include "ZEPAppPages.h"
#include "ZEPAppRender.h"
#include "ZEPAppServe.h"
#include "ZEPAppSettingsFile.h"
#include "ZEPAppSettingsRules.h"
#include "ZEPAppSketcher.h"
#include "ZEPAppStandards.h"

#include <CLI/CLI.hpp>
#include <nlohmann/json.hpp>

#include <algorithm>
#include <cctype>
#include <filesystem>
#include <map>
#include <memory>
#include <optional>
#include <sstream>

namespace zepapp {

namespace {

std::string Quoted(const std::string& s) { return "\"" + s + "\""; }

std::string Lower(std::string s) {
  for (char& c : s)
    c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
  return s;
}

std::string Pad(const std::string& s, std::size_t iWidth) {
  const std::size_t w = TextWidth(s);
  return w >= iWidth ? s : s + std::string(iWidth - w, ' ');
}

std::string ScaleName(int iRange) {
  ZEPICkeScalesServices_var scales = ZEPGlobalFunctions2::GetScalesServices();
  return scales ? scales->GetScaleName(static_cast<ZEPCkeScale>(iRange)).str()
                : std::to_string(iRange);
}

// What the command line asked for.
struct Request {
  std::string settings, admin, standards, plm;
  std::string page, control, value, attribute, html;
  std::vector<std::string> pages;
  std::vector<std::string> args; // a setting's key, then its value where one is taken
  bool hasValue = false;
  int range = 0; // 0: the range the grid page opens on
  bool all = false, json = false, raw = false, remove = false;
  int port = 0;       // serve: 0 for a free port
  bool noOpen = false; // serve: do not ask the desktop to open the page
};

// Takes the setting named at the start of the request's arguments (PAGE CONTROL, PAGE.CONTROL
// or its stored attribute) and between iMin and iMax values after it.
int TakeKey(Request& ioRequest, std::size_t iMin, std::size_t iMax, std::ostream& err) {
  ZEPAppKey key;
  std::size_t used = 0;
  std::string error;
  if (!ResolveKey(ioRequest.args, key, used, error)) {
    err << "error: " << error << "\n";
    return kExitUsage;
  }
  const std::size_t values = ioRequest.args.size() - used;
  if (values < iMin || values > iMax) {
    err << "error: " << (values < iMin ? "a value is needed after " : "too many values after ") << key.page->name
        << "." << key.control << "\n";
    return kExitUsage;
  }
  ioRequest.page = key.page->name;
  ioRequest.control = key.control;
  ioRequest.hasValue = values > 0;
  ioRequest.value = values > 0 ? ioRequest.args[used] : "";
  ioRequest.attribute = key.setting ? key.setting->stored : "";
  return kExitOk;
}

const char* KindName(ZEPAppKind iKind) {
  switch (iKind) {
  case ZEPAppKind::Check:
    return "check";
  case ZEPAppKind::Spinner:
    return "spinner";
  case ZEPAppKind::Combo:
    return "combo";
  case ZEPAppKind::Choice:
    return "choice";
  case ZEPAppKind::Push:
    return "button";
  case ZEPAppKind::Editor:
    return "editor";
  case ZEPAppKind::Other:
    break;
  }
  return "other";
}

// Whether a row of the settings table holds one text rather than a list of texts.
bool IsSingleText(const ZEPAppSetting& iSetting) {
  return StoredKindOf(iSetting) == ZEPAppStored::Text;
}

// A value as JSON: numbers in an array, one text as a string, a list of texts as an array of
// strings. iSingleText: the value is one text.
nlohmann::json ValueJson(const ZEPAppValue& iValue, bool iSingleText) {
  if (const auto* texts = std::get_if<std::vector<std::string>>(&iValue); texts && iSingleText)
    return texts->empty() ? std::string() : texts->front();
  return std::visit([](const auto& v) { return nlohmann::json(v); }, iValue);
}

// The values a repository reads for an attribute, as JSON; null when it has none.
nlohmann::json StoredJson(const ZEPAppSetting& iSetting) {
  const ZEPSysSettingRepository* repo = ZEPSysSettingRepository::GetRepository(iSetting.repository.c_str());
  const ZEPAppValue* value = repo ? repo->Effective(iSetting.stored) : nullptr;
  if (!value) return nullptr;
  return ValueJson(*value, IsSingleText(iSetting));
}

// A value as text: numbers in the shortest forms that read back exactly, on one line; texts as
// they are, one a line.
std::string ValueText(const nlohmann::json& iValue) {
  if (iValue.is_string()) return iValue.get<std::string>();
  std::string text;
  for (const auto& v : iValue)
    text += v.is_string() ? (text.empty() ? "" : "\n") + v.get<std::string>()
                          : (text.empty() ? "" : " ") + FormatNumber(v.get<double>());
  return text;
}

// The stored values as text.
std::string StoredText(const ZEPAppSetting& iSetting) { return ValueText(StoredJson(iSetting)); }

// The application's default of a row, as JSON.
nlohmann::json DefaultJson(const ZEPAppSetting& iSetting) {
  if (!iSetting.text) return iSetting.defaults;
  return ValueJson(iSetting.texts, IsSingleText(iSetting));
}

// Every row of the settings table a control of the page shows, its first row first: the
// standard combo shows the name, its source flag and the two PLM lists. Empty for a control
// that stores nothing.
std::vector<const ZEPAppSetting*> RowsOf(const ZEPAppPage& iPage, const std::string& iControl) {
  std::vector<const ZEPAppSetting*> rows;
  const ZEPAppSetting* first = SettingOf(iPage, iControl);
  if (!first) return rows;
  for (const ZEPAppSetting& s : AppSettings())
    if (s.page == first->page && s.control == first->control) rows.push_back(&s);
  return rows;
}

// The row a request names: its stored attribute when it gave one, else the control's first.
const ZEPAppSetting* RowOf(const ZEPAppPage& iPage, const std::string& iControl, const std::string& iAttribute) {
  for (const ZEPAppSetting* s : RowsOf(iPage, iControl))
    if (s->stored == iAttribute) return s;
  return SettingOf(iPage, iControl);
}

} // namespace

nlohmann::json ControlJson(const ZEPAppPage& iPage, const std::vector<ZEPAppControl>& iControls,
                           const ZEPAppControl& iControl, const ZEPAppSetting* iSetting) {
  const ZEPAppSetting* setting = iSetting ? iSetting : SettingOf(iPage, iControl.name);
  nlohmann::json j = {{"page", iPage.name},
                      {"control", iControl.name},
                      {"key", iPage.name + "." + iControl.name},
                      {"title", iControl.Title()},
                      {"kind", KindName(iControl.Kind())},
                      {"section", iControl.section},
                      {"shown", iControl.Shown()},
                      {"locked", iControl.Locked()},
                      {"lockedBy", iControl.LockText()},
                      {"enabled", !iControl.Disabled()},
                      {"whyNot", WhyRefused(iControls, iControl)}};
  j["attribute"] = setting ? nlohmann::json(setting->stored) : nlohmann::json(nullptr);
  if (setting) {
    j["repository"] = setting->repository;
    j["stored"] = StoredJson(*setting);
    j["default"] = DefaultJson(*setting);
  }
  return j;
}

bool PrepareChooser(const ZEPAppControl& iControl, const std::string& iPLMRepository, ZEPAppOutcome& oOutcome) {
  if (iControl.name != "pusStandardPLMAdd") return true;
  std::string error;
  if (LoadPLMRepository(iPLMRepository, error)) return true;
  oOutcome.code = kExitFile;
  oOutcome.message = "the PLM repository cannot be used: " + error + "\nnothing was changed";
  return false;
}

long LoadSettingsFiles(ZEPAppSettingsFile& ioFile, const ZEPAppSettingsPaths& iPaths) {
  ioFile.SetRules(AppSettingRules());
  const long rc = ioFile.Load(iPaths.user, iPaths.admin);
  for (const std::string& name : AppRepositories())
    ioFile.OpenSettings(name);
  ioFile.OpenPreferences("DraftingOptions"); // where dialogs keep their places
  ApplyDefaults();
  return rc;
}

ZEPAppOutcome ChangeSetting(ZEPAppSettingsFile& ioFile, const std::vector<ZEPAppControl>& iControls,
                            const ZEPAppControl& iControl, const std::string& iValue,
                            const std::string& iPLMRepository) {
  ZEPAppOutcome outcome;
  if (!PrepareChooser(iControl, iPLMRepository, outcome)) return outcome;
  outcome = OperateControl(iControls, iControl, iValue);
  CloseSubDialog(iControl); // as the user closes the dialog the change was made in
  if (outcome.code == kExitOk && outcome.changed && FAILED(ioFile.SaveAll())) {
    outcome.code = kExitFile;
    outcome.message = "the change was not saved: " + ioFile.LastError();
  }
  return outcome;
}

ZEPAppRenderPage RenderedPage(const ZEPAppPage& iPage, ZEPDlgFrame* iFrame,
                              const std::vector<ZEPAppControl>& iControls) {
  ZEPAppRenderPage shown;
  shown.name = iPage.name;
  shown.title = iPage.title;
  shown.frame = iFrame;
  if (int range = ShownRange(iControls))
    shown.note = std::string(iPage.name == "main" ? "Scale ratio" : "Spacing and graduations") + " of the " +
                 ScaleName(range) + " scale range";
  for (const ZEPAppControl& c : iControls)
    if (c.opener && (shown.dialogs.empty() || shown.dialogs.back().dialog != c.subDialog))
      shown.dialogs.push_back({c.opener, c.subDialog});
  for (const ZEPAppControl& c : iControls) shown.whyNot[c.inner] = WhyRefused(iControls, c);
  return shown;
}

namespace {

// One run of the application: the settings files, the repositories bound to them and the
// pages opened on a top-level window.
class Session {
public:
  Session(std::ostream& out, std::ostream& err) : _out(out), _err(err) {}
  ~Session() {
    _pRoot.reset(); // the pages go before the repositories they are bound to
    ZEPDlgDriver::Idle();
  }

  // Loads the files. Values that are not used are reported; a faulty file is reported and a
  // command that writes stops there (a faulty administrator's file stops every write).
  int Start(const Request& iRequest, bool iWrites) {
    _paths = ResolveSettingsPaths(iRequest.settings, iRequest.admin);
    const long rc = LoadSettingsFiles(_file, _paths);
    _plmPath = ResolvePLMRepository(iRequest.plm);
    if (const std::string why = UseStandardsFolder(ResolveStandardsFolder(iRequest.standards)); !why.empty())
      _err << "warning: " << why << "\n";
    _pRoot = std::make_unique<ZEPDlgWindow>(nullptr, "DraftingOptions", 0);
    for (const ZEPAppFileError& w : _file.LoadWarnings())
      _err << "warning: " << w.Text() << "\n";
    for (const std::string& w : DisagreeingSettings()) _err << "warning: " << w << "\n";
    if (SUCCEEDED(rc)) return kExitOk;
    // A file that cannot be read at all (a FIFO, a device, too large) is not shown around.
    bool userFaulty = false, unreadable = false;
    for (const ZEPAppFileError& e : _file.LoadErrors()) {
      userFaulty = userFaulty || e.path == _paths.user;
      unreadable = unreadable || e.unreadable;
    }
    for (const ZEPAppFileError& e : _file.LoadErrors())
      _err << (iWrites || unreadable ? "error: " : "warning: ") << e.Text() << "\n";
    if (iWrites || unreadable) {
      _err << "error: nothing was changed; correct or remove the faulty file, then try again\n";
      return kExitFile;
    }
    if (userFaulty) _err << "warning: the values shown leave the faulty file out\n";
    if (_file.AdminFault())
      _err << "warning: no change is accepted until the administrator's file is corrected; the locks "
              "shown are those that could be read\n";
    return kExitOk;
  }

  // The page of that name, or null after listing the valid ones.
  const ZEPAppPage* Page(const std::string& iName) {
    if (const ZEPAppPage* page = FindPage(Lower(iName))) return page;
    std::vector<std::string> names;
    for (const ZEPAppPage& p : AppPages()) names.push_back(p.name);
    _err << "error: unknown page " << Quoted(iName) << "." << DidYouMean(iName, names) << " The pages are:";
    for (const std::string& name : names) _err << " " << name;
    _err << "\n";
    return nullptr;
  }

  // Builds and initialises the page once; a page opened again reads the repositories anew.
  ZEPDlgFrame* Open(const ZEPAppPage& iPage, bool iAfresh = false) {
    auto it = _opened.find(iPage.name);
    if (it != _opened.end() && !iAfresh) return it->second;
    if (it != _opened.end()) delete it->second;
    return _opened[iPage.name] = iPage.open(_pRoot.get());
  }

  // The controls of an opened page showing iRange (0: as it opened).
  int Controls(const ZEPAppPage& iPage, int iRange, std::vector<ZEPAppControl>& oControls) {
    oControls = PageControls(Open(iPage), iPage.dialogButtons);
    if (iRange == 0) return kExitOk;
    if (ShownRange(oControls) == 0) {
      _err << "error: --range applies to the pages with a scale range only (grid, main)\n";
      return kExitUsage;
    }
    const ZEPAppOutcome outcome = SelectRange(oControls, iRange);
    if (outcome.code != kExitOk) _err << "error: " << outcome.message << "\n";
    return outcome.code;
  }

  // Loads the files, then finds the request's page (showing its range) and, when asked, its
  // control; a non-zero exit code after reporting what was wrong.
  int Target(const Request& iRequest, bool iWrites, const ZEPAppPage*& oPage,
             std::vector<ZEPAppControl>& oControls, const ZEPAppControl** oControl) {
    if (int rc = Start(iRequest, iWrites)) return rc;
    oPage = Page(iRequest.page);
    if (!oPage) return kExitUsage;
    if (int rc = Controls(*oPage, iRequest.range, oControls)) return rc;
    if (!oControl) return kExitOk;
    *oControl = Control(*oPage, oControls, iRequest.control);
    return *oControl ? kExitOk : kExitUsage;
  }

  const ZEPAppControl* Control(const ZEPAppPage& iPage, const std::vector<ZEPAppControl>& iControls,
                               const std::string& iName) {
    if (const ZEPAppControl* control = FindPageControl(iControls, iName)) return control;
    std::vector<std::string> names;
    for (const ZEPAppControl& c : iControls) names.push_back(c.name);
    _err << "error: unknown control " << Quoted(iName) << " on page " << iPage.name << "."
         << DidYouMean(iName, names) << " Its controls are:\n";
    std::size_t width = 0;
    for (const ZEPAppControl& c : iControls)
      width = std::max(width, c.name.size());
    for (const ZEPAppControl& c : iControls)
      _err << "  " << Pad(c.name, width) << "  " << c.Title() << "\n";
    for (const ZEPAppControl& c : iControls)
      if (c.Kind() == ZEPAppKind::Push && c.Disabled())
        _err << "the controls of the dialog of " << Quoted(c.Title())
             << " are not listed: " << WhyRefused(iControls, c) << "\n";
    return nullptr;
  }

  // The page as lines: section titles, then each control's title, value and marks.
  void Print(const ZEPAppPage& iPage, const std::vector<ZEPAppControl>& iControls,
             bool iWithNames) {
    _out << iPage.title << "  [" << iPage.name << "]";
    if (int range = ShownRange(iControls))
      _out << "  scale range " << range << ": " << ScaleName(range);
    _out << "\n";
    std::size_t nameWidth = 0, titleWidth = 0, valueWidth = 0, attributeWidth = 0;
    auto attribute = [&iPage](const ZEPAppControl& c) {
      const ZEPAppSetting* s = SettingOf(iPage, c.name);
      return s ? s->stored : std::string("-");
    };
    for (const ZEPAppControl& c : iControls) {
      nameWidth = std::max(nameWidth, c.name.size());
      titleWidth = std::max(titleWidth, TextWidth(c.Title()));
      valueWidth = std::max(valueWidth, TextWidth(c.Shown()));
      attributeWidth = std::max(attributeWidth, attribute(c).size());
    }
    std::string section = "\x01"; // no section yet
    for (const ZEPAppControl& c : iControls) {
      if (c.section != section) {
        section = c.section;
        if (!section.empty()) _out << "  " << section << "\n";
      }
      std::string marks;
      if (c.Kind() == ZEPAppKind::Push)
        marks += c.name == "pusStandardPLMAdd"      ? "  (button: give it a PLM standard's name or key to add)"
                 : c.name == "pusStandardPLMRemove" ? "  (button: give it a listed PLM standard to remove)"
                                                    : "  (button: opens a dialog)";
      if (c.Locked())
        marks += "  \xF0\x9F\x94\x92 " + c.LockText();
      else if (c.Disabled())
        marks += "  (disabled)";
      std::string line = "    ";
      if (iWithNames) line += Pad(c.name, nameWidth) + "  ";
      line += Pad(c.Title(), titleWidth) + "  ";
      if (iWithNames)
        line += Pad(c.Shown(), valueWidth) + "  " + (marks.empty() ? attribute(c) : Pad(attribute(c), attributeWidth));
      else
        line += marks.empty() ? c.Shown() : Pad(c.Shown(), valueWidth);
      _out << line + marks << "\n";
    }
  }

  ZEPAppSettingsFile& File() { return _file; }
  const ZEPAppSettingsPaths& Paths() const { return _paths; }

  // Reads the PLM repository for the chooser, before a control that opens it is operated; a
  // non-zero exit code after saying why the file cannot be used.
  int PrepareChooser(const ZEPAppControl& iControl) {
    ZEPAppOutcome outcome;
    if (zepapp::PrepareChooser(iControl, _plmPath, outcome)) return kExitOk;
    _err << "error: " << outcome.message << "\n";
    return outcome.code;
  }
  const std::string& PLMRepository() const { return _plmPath; }

private:
  std::string _plmPath;
  std::ostream& _out;
  std::ostream& _err;
  ZEPAppSettingsPaths _paths;
  ZEPAppSettingsFile _file;
  std::unique_ptr<ZEPDlgWindow> _pRoot;
  std::map<std::string, ZEPDlgFrame*> _opened;
};

std::string Described(const std::string& iPath, const char* iNone) {
  if (iPath.empty()) return iNone;
  std::error_code ec;
  return iPath + (std::filesystem::exists(iPath, ec) ? "" : " (no file yet: defaults)");
}

// ---- commands -----------------------------------------------------------------------------------
int Overview(const Request& iRequest, std::ostream& out, std::ostream& err) {
  Session session(out, err);
  if (int rc = session.Start(iRequest, false)) return rc;
  out << "Drafting options\n";
  out << "  settings: " << Described(session.Paths().user, "none (nothing can be saved)") << "\n";
  out << "  administrator's settings: "
      << (session.Paths().admin.empty() ? "none" : session.Paths().admin) << "\n";
  for (const ZEPAppPage& page : AppPages()) {
    std::vector<ZEPAppControl> controls;
    if (int rc = session.Controls(page, 0, controls)) return rc;
    out << "\n";
    session.Print(page, controls, false);
  }
  out << "\n'" << kAppName << " show PAGE' lists the control names that get, set and reset take.\n";
  return kExitOk;
}

int ListPages(const Request& iRequest, std::ostream& out) {
  if (iRequest.json) {
    nlohmann::json all = nlohmann::json::array();
    for (const ZEPAppPage& p : AppPages()) all.push_back({{"page", p.name}, {"title", p.title}});
    out << all.dump(2) << "\n";
    return kExitOk;
  }
  std::size_t width = 0;
  for (const ZEPAppPage& p : AppPages())
    width = std::max(width, p.name.size());
  for (const ZEPAppPage& p : AppPages())
    out << Pad(p.name, width) << "  " << p.title << "\n";
  return kExitOk;
}

// What the sketcher reads from the same repositories (the grid page writes part of it).
int Sketcher(const Request& iRequest, std::ostream& out, std::ostream& err) {
  Session session(out, err);
  if (int rc = session.Start(iRequest, false)) return rc;
  PrintSketcherSettings(out, &session.File());
  return kExitOk;
}

int Show(const Request& iRequest, std::ostream& out, std::ostream& err) {
  Session session(out, err);
  const ZEPAppPage* page = nullptr;
  std::vector<ZEPAppControl> controls;
  if (int rc = session.Target(iRequest, false, page, controls, nullptr)) return rc;
  if (!iRequest.json) {
    session.Print(*page, controls, true);
    return kExitOk;
  }
  nlohmann::json j = {{"page", page->name}, {"title", page->title}, {"range", ShownRange(controls)}};
  j["controls"] = nlohmann::json::array();
  for (const ZEPAppControl& c : controls) j["controls"].push_back(ControlJson(*page, controls, c));
  out << j.dump(2) << "\n";
  return kExitOk;
}

int Get(const Request& iRequest, std::ostream& out, std::ostream& err) {
  Session session(out, err);
  const ZEPAppPage* page = nullptr;
  std::vector<ZEPAppControl> controls;
  const ZEPAppControl* control = nullptr;
  if (int rc = session.Target(iRequest, false, page, controls, &control)) return rc;
  const ZEPAppSetting* setting = RowOf(*page, control->name, iRequest.attribute);
  const bool ownRow = setting && setting == SettingOf(*page, control->name);
  if (iRequest.json)
    out << ControlJson(*page, controls, *control, setting).dump(2) << "\n";
  else if ((iRequest.raw || !ownRow) && setting) // a further setting of the control: what it holds
    out << StoredText(*setting) << "\n";
  else if (iRequest.raw)
    out << control->Shown() << "\n"; // a control without setting stores nothing
  else
    out << control->Shown() << "\n";
  return kExitOk;
}

// Every setting of every page, its dialogs' included: one line each, or JSON.
int List(const Request& iRequest, std::ostream& out, std::ostream& err) {
  Session session(out, err);
  if (int rc = session.Start(iRequest, false)) return rc;
  nlohmann::json all = nlohmann::json::array();
  for (const ZEPAppPage& page : AppPages()) {
    std::vector<ZEPAppControl> controls;
    if (int rc = session.Controls(page, 0, controls)) return rc;
    for (const ZEPAppControl& c : controls)
      for (const ZEPAppSetting* setting : RowsOf(page, c.name)) {
        if (setting->page != page.table) break; // an embedded page's: listed on its own page
        if (iRequest.json) {
          all.push_back(ControlJson(page, controls, c, setting));
          continue;
        }
        // A further setting of the control: what it holds, as JSON.
        out << page.name << "." << c.name << "  " << setting->stored << "  "
            << (setting == SettingOf(page, c.name) ? c.Shown() : StoredJson(*setting).dump());
        if (c.Locked()) out << "  (locked: " << c.LockText() << ")";
        else if (c.Disabled()) out << "  (disabled)";
        out << "\n";
      }
  }
  if (iRequest.json) out << all.dump(2) << "\n";
  return kExitOk;
}

int Set(const Request& iRequest, std::ostream& out, std::ostream& err) {
  Session session(out, err);
  const ZEPAppPage* page = nullptr;
  std::vector<ZEPAppControl> controls;
  const ZEPAppControl* control = nullptr;
  if (int rc = session.Target(iRequest, true, page, controls, &control)) return rc;
  const int range = ShownRange(controls);
  const ZEPAppOutcome outcome = ChangeSetting(session.File(), controls, *control, iRequest.value, session.PLMRepository());
  if (outcome.code != kExitOk) {
    err << "error: " << outcome.message << (outcome.code == kExitFile ? "\n" : "\nnothing was changed\n");
    return outcome.code;
  }
  if (!outcome.warning.empty()) err << "warning: " << outcome.warning << "\n";
  out << outcome.message;
  const ZEPAppSetting* setting = SettingOf(*page, control->name);
  if (setting && setting->defaults.size() > 1 && range)
    out << "  (scale range " << range << ": " << ScaleName(range) << ")";
  if (!setting && !control->opensNewerDialog && control->Kind() != ZEPAppKind::Push)
    out << "  (only for this run: it stores nothing; --range N chooses a range)";
  out << "\n";
  return kExitOk;
}

int Reset(const Request& iRequest, std::ostream& out, std::ostream& err) {
  if (iRequest.all == !iRequest.page.empty() ||
      (!iRequest.page.empty() && iRequest.control.empty())) {
    err << "error: reset takes PAGE CONTROL, or --all\n";
    return kExitUsage;
  }
  Session session(out, err);
  if (int rc = session.Start(iRequest, true)) return rc;
  if (iRequest.all) {
    if (FAILED(session.File().ResetAll())) {
      err << "error: " << session.File().LastError() << "\n";
      return kExitFile;
    }
    out << "Every setting is back to its default";
    int kept = 0;
    for (const ZEPAppSetting& s : AppSettings()) {
      ZEPSysSettingRepository* repo = ZEPSysSettingRepository::GetRepository(s.repository.c_str());
      kept += repo && repo->IsLocked(s.stored) ? 1 : 0;
    }
    if (kept) out << ", except " << kept << " locked by the administrator";
    out << ".\n";
    return kExitOk;
  }
  const ZEPAppPage* page = session.Page(iRequest.page);
  if (!page) return kExitUsage;
  std::vector<ZEPAppControl> controls;
  if (int rc = session.Controls(*page, 0, controls)) return rc;
  const ZEPAppControl* control = session.Control(*page, controls, iRequest.control);
  if (!control) return kExitUsage;
  const ZEPAppSetting* setting = SettingOf(*page, control->name);
  if (!setting) {
    err << "error: " << Quoted(control->Title()) << " (" << control->name
        << ") keeps no setting of its own\n";
    return kExitUsage;
  }
  // Every setting the control shows goes back together.
  const std::vector<const ZEPAppSetting*> rows = RowsOf(*page, control->name);
  for (const ZEPAppSetting* row : rows) {
    ZEPSysSettingRepository* repo = ZEPSysSettingRepository::GetRepository(row->repository.c_str());
    ZEPSettingInfo info;
    if (repo && repo->IsLocked(row->stored) && SUCCEEDED(repo->GetLockInfo(row->stored, info))) {
      err << "error: " << Quoted(control->Title()) << " is locked: "
          << (info.GetLockText().empty() ? "Locked by an administrator" : info.GetLockText())
          << "\nnothing was changed\n";
      return kExitRefused;
    }
  }
  const std::string name = control->name, title = control->Title();
  for (const ZEPAppSetting* row : rows)
    if (FAILED(session.File().Reset(row->repository, row->stored))) {
      err << "error: " << session.File().LastError() << "\n";
      return kExitFile;
    }
  controls = PageControls(session.Open(*page, true), page->dialogButtons); // shows the default now
  const ZEPAppControl* shown = FindPageControl(controls, name);
  out << title << ": " << (shown ? shown->Shown() : "") << " (default";
  if (setting->defaults.size() > 1) out << ", every scale range";
  out << ")\n";
  return kExitOk;
}

// lock KEY [VALUE], unlock KEY, default KEY VALUE and default --remove KEY: the administrator's
// file. A value is taken as set takes it, by operating the control on this run only (nothing is
// written to the user's file), then recorded in the administrator's file.
int Administer(const Request& iRequest, ZEPAppAdminAction iAction, std::ostream& out, std::ostream& err) {
  Session session(out, err);
  const ZEPAppPage* page = nullptr;
  std::vector<ZEPAppControl> controls;
  const ZEPAppControl* control = nullptr;
  if (int rc = session.Target(iRequest, true, page, controls, &control)) return rc;
  if (session.Paths().admin.empty()) {
    err << "error: no administrator's file: give --admin FILE or set " << kAdminFileEnv << "\n";
    return kExitUsage;
  }
  const ZEPAppSetting* setting = SettingOf(*page, control->name);
  if (!setting) {
    err << "error: " << Quoted(control->Title()) << " (" << control->name << ") keeps no setting of its own\n";
    return kExitUsage;
  }
  // Every setting the control shows is administered together (the standard's name with its
  // source flag and the PLM lists): a lock on part of them would leave the rest to disagree.
  const std::vector<const ZEPAppSetting*> rows = RowsOf(*page, control->name);
  std::vector<std::optional<ZEPAppValue>> values(rows.size());
  if (iRequest.hasValue) {
    bool wasLocked = false; // a new value for a lock: the control must take it first
    for (const ZEPAppSetting* row : rows)
      if (ZEPSysSettingRepository* repo = ZEPSysSettingRepository::GetRepository(row->repository.c_str()))
        if (repo->IsLocked(row->stored)) {
          repo->SetLock(row->stored, false);
          wasLocked = true;
        }
    if (wasLocked) {
      const std::string name = control->name;
      session.Open(*page, true);
      if (int rc = session.Controls(*page, iRequest.range, controls)) return rc;
      control = FindPageControl(controls, name);
      if (!control) return kExitFailure;
    }
    if (int rc = session.PrepareChooser(*control)) return rc;
    const ZEPAppOutcome outcome = OperateControl(controls, *control, iRequest.value);
    CloseSubDialog(*control);
    if (outcome.code != kExitOk) {
      err << "error: " << outcome.message << "\nnothing was changed\n";
      return outcome.code;
    }
    if (!outcome.warning.empty()) err << "warning: " << outcome.warning << "\n";
    for (std::size_t i = 0; i < rows.size(); ++i)
      if (const ZEPSysSettingRepository* repo = ZEPSysSettingRepository::GetRepository(rows[i]->repository.c_str()))
        if (const ZEPAppValue* now = repo->Effective(rows[i]->stored)) values[i] = *now;
  }
  std::string attribute; // the stored attributes, for the messages
  for (const ZEPAppSetting* row : rows) attribute += (attribute.empty() ? "" : ", ") + row->stored;
  // In one write: should it fail, no part of the group has changed.
  std::vector<ZEPAppAdminEdit> edits;
  for (std::size_t i = 0; i < rows.size(); ++i) edits.push_back({iAction, rows[i]->repository, rows[i]->stored, values[i]});
  const long rc = session.File().Administer(edits);
  if (FAILED(rc)) {
    err << "error: " << session.File().LastError() << "\n";
    return kExitFile;
  }
  if (rc == 1) {
    out << attribute
        << (iAction != ZEPAppAdminAction::Unlock ? " had no default" : rows.size() > 1 ? " were not locked" : " was not locked")
        << "; nothing changed\n";
    return kExitOk;
  }
  // What the page shows now, padlock included.
  const std::string name = control->name;
  session.Open(*page, true);
  if (int rc2 = session.Controls(*page, iRequest.range, controls)) return rc2;
  const ZEPAppControl* shown = FindPageControl(controls, name);
  static const char* const kDone[] = {"Locked ", "Unlocked ", "Default for everyone of ", "Removed the default of "};
  out << kDone[static_cast<int>(iAction)] << attribute << " (" << page->name << "." << name << ") in "
      << session.File().AdminPath() << "\n";
  if (iAction == ZEPAppAdminAction::RemoveDefault)
    out << "  the application's own default applies from the next command on\n";
  else if (shown)
    out << "  " << shown->Title() << " = " << shown->Shown() << "\n";
  return kExitOk;
}

// Every lock and default of the administrator's file, with who locked it.
int Locks(const Request& iRequest, std::ostream& out, std::ostream& err) {
  Session session(out, err);
  if (int rc = session.Start(iRequest, false)) return rc;
  nlohmann::json all = nlohmann::json::array();
  for (const auto& [repository, entries] : session.File().AdminDoc().settings)
    for (const auto& [attribute, entry] : entries) {
      std::string key;
      for (const ZEPAppSetting& s : AppSettings())
        if (s.repository == repository && s.stored == attribute)
          if (const ZEPAppPage* p = PageOf(s)) key = p->name + "." + s.control;
      nlohmann::json value = nullptr;
      bool singleText = false;
      for (const ZEPAppSetting& s : AppSettings())
        if (s.repository == repository && s.stored == attribute) singleText = IsSingleText(s);
      if (entry.value) value = ValueJson(*entry.value, singleText);
      all.push_back({{"repository", repository},
                     {"attribute", attribute},
                     {"key", key.empty() ? nlohmann::json(nullptr) : nlohmann::json(key)},
                     {"locked", entry.locked},
                     {"by", entry.by},
                     {"value", value}});
    }
  if (iRequest.json) {
    out << all.dump(2) << "\n";
    return kExitOk;
  }
  out << "Administrator's file: " << (session.Paths().admin.empty() ? "none" : session.Paths().admin) << "\n";
  if (all.empty()) out << "  no lock and no default\n";
  for (const auto& e : all) {
    std::string values = e["value"].is_null() ? std::string() : ValueText(e["value"]);
    for (char& c : values)
      if (c == '\n') c = ','; // a list of texts on the line
    out << "  " << e["attribute"].get<std::string>() << "  "
        << (e["key"].is_null() ? std::string("(no control)") : e["key"].get<std::string>()) << "  " << values << "  "
        << (e["locked"].get<bool>() ? "locked by " + e["by"].get<std::string>() : std::string("default")) << "\n";
  }
  return kExitOk;
}

// A bash completion script: commands, pages, each page's controls and the stored attributes.
int Completion(std::ostream& out) {
  std::string pages, keys;
  std::ostringstream perPage;
  ZEPAppSettingsFile file; // no files: the application's defaults
  for (const std::string& name : AppRepositories()) file.OpenSettings(name);
  ApplyDefaults();
  ZEPDlgWindow root(nullptr, "DraftingOptions", 0);
  for (const ZEPAppPage& page : AppPages()) {
    pages += " " + page.name;
    std::string controls;
    for (const ZEPAppControl& c : PageControls(page.open(&root), page.dialogButtons)) {
      controls += " " + c.name;
      keys += " " + page.name + "." + c.name;
    }
    perPage << "    " << page.name << ") words=\"" << controls.substr(controls.empty() ? 0 : 1) << "\" ;;\n";
  }
  for (const ZEPAppSetting& s : AppSettings()) keys += " " + s.stored;
  ZEPDlgDriver::Idle();
  out << "# bash completion for " << kAppName << ": source it, or put it in ~/.local/share/bash-completion/completions/\n"
      << "_drafting_options() {\n"
      << "  local cur=${COMP_WORDS[COMP_CWORD]} prev=${COMP_WORDS[COMP_CWORD-1]} words\n"
      << "  local commands=\"pages show get set reset lock unlock default locks list render serve sketcher completion\"\n"
      << "  local pages=\"" << pages.substr(1) << "\"\n"
      << "  local keys=\"" << keys.substr(1) << "\"\n"
      << "  case \"$prev\" in\n"
      << "    drafting-options) words=\"$commands\" ;;\n"
      << "    show|render) words=\"$pages\" ;;\n"
      << "    get|set|reset|lock|unlock|default) words=\"$pages $keys\" ;;\n"
      << perPage.str() << "    *) words=\"\" ;;\n"
      << "  esac\n"
      << "  COMPREPLY=($(compgen -W \"$words\" -- \"$cur\"))\n"
      << "}\n"
      << "complete -F _drafting_options " << kAppName << "\n";
  return kExitOk;
}

int Render(const Request& iRequest, std::ostream& out, std::ostream& err) {
  Session session(out, err);
  if (int rc = session.Start(iRequest, false)) return rc;
  std::vector<const ZEPAppPage*> pages;
  for (const std::string& name : iRequest.pages) {
    const ZEPAppPage* page = session.Page(name);
    if (!page) return kExitUsage;
    if (std::find(pages.begin(), pages.end(), page) == pages.end()) pages.push_back(page);
  }
  if (pages.empty())
    for (const ZEPAppPage& p : AppPages())
      pages.push_back(&p);
  std::vector<ZEPAppRenderPage> rendered;
  bool ranged = false;
  for (const ZEPAppPage* page : pages) {
    std::vector<ZEPAppControl> controls;
    if (int rc = session.Controls(*page, 0, controls)) return rc;
    if (ShownRange(controls)) {
      if (int rc = session.Controls(*page, iRequest.range, controls)) return rc;
      ranged = true;
    }
    rendered.push_back(RenderedPage(*page, session.Open(*page), controls));
  }
  if (iRequest.range && !ranged) {
    err << "error: --range applies to the pages with a scale range only (grid, main)\n";
    return kExitUsage;
  }
  ZEPAppRenderContext context{session.Paths().user, session.Paths().admin,
                              std::string(kAppName) + " " + kAppVersion,
                              session.File().AdminFault() ? session.File().AdminFault()->Text() : ""};
  const std::string html = RenderHtml(rendered, context);
  if (iRequest.html == "-") {
    out << html;
    return kExitOk;
  }
  ZEPAppPosixFileOps ops;
  std::string error;
  if (FAILED(WriteFileAtomically(ops, iRequest.html, html, error))) {
    err << "error: " << error << "\n";
    return kExitFile;
  }
  out << "Wrote " << iRequest.html << " (" << rendered.size()
      << (rendered.size() == 1 ? " page" : " pages") << ")\n";
  return kExitOk;
}

int Run(int argc, const char* const* argv, std::ostream& out, std::ostream& err) {
  CLI::App app{
      "The drafting options dialog of the CAD host on its settings files: show the pages,\n"
      "change a setting through its control as a user would, lock settings, render the pages.",
      kAppName};
  app.fallthrough(); // global options also after the command
  app.require_subcommand(0, 1);
  app.set_version_flag("--version", std::string(kAppName) + " " + kAppVersion +
                                        "\nresources: " + ZEPMsgCatalog::ResourceDir());
  Request r;
  app.add_option("--settings", r.settings,
                 "The user's settings file (default: $" + std::string(kSettingsFileEnv) +
                     ", else $XDG_CONFIG_HOME or ~/.config, drafting-options/settings.json)");
  app.add_option("--admin", r.admin,
                 "The administrator's settings file: defaults and locks (default: $" +
                     std::string(kAdminFileEnv) + ", else drafting-options/admin.json in $XDG_CONFIG_DIRS, "
                     "/etc/xdg by default)");
  app.add_option("--standards", r.standards,
                 "The standards folder: its drafting/ folder holds the folder standards (default: $" +
                     std::string(kStandardsFolderEnv) + ", else the sample standards of the resources)");
  app.add_option("--plm-repository", r.plm,
                 "The PLM repository file whose standards the PLM chooser lists (default: $" +
                     std::string(kPLMRepositoryEnv) + ", else the sample plm/standards.json of the resources)");
  auto rangeOption = [&r](CLI::App* cmd) {
    cmd->add_option("--range", r.range, "Grid and main pages: the scale range to work on, 1 to 5")
        ->check(CLI::Range(1, 5));
  };

  const std::string keyHelp = "The setting: PAGE CONTROL, PAGE.CONTROL or its stored attribute (see show)";
  const std::string valueHelp =
      "on/off for a check box; a number with an optional unit (25mm, 2.5cm, 1in, 15deg) for a spinner; a line "
      "number from 1 or a line's text for a combo or a group of radio buttons; a text for an editor (a scale "
      "ratio as 1:50 for edtScaleRatio); a PLM standard's name or key for the main page's add and remove buttons";
  auto keyArgs = [&r](CLI::App* cmd, const std::string& iHelp, int iMin, int iMax) {
    cmd->add_option("key", r.args, iHelp)->expected(iMin, iMax);
  };
  auto jsonFlag = [&r](CLI::App* cmd) { cmd->add_flag("--json", r.json, "Machine-readable output (JSON)"); };

  CLI::App* pages = app.add_subcommand("pages", "List the pages");
  jsonFlag(pages);
  CLI::App* show =
      app.add_subcommand("show", "Show a page: each control's name, title, value, attribute and padlock");
  show->add_option("page", r.page, "Page name")->required();
  rangeOption(show);
  jsonFlag(show);
  show->footer("Examples:\n  " + std::string(kAppName) + " show grid --range 2\n  " + kAppName +
               " show geometry --json");
  CLI::App* get = app.add_subcommand("get", "Print the value a control shows");
  keyArgs(get, keyHelp, 1, 2);
  rangeOption(get);
  jsonFlag(get);
  get->add_flag("--raw", r.raw, "The stored value (millimetres, degrees, codes) rather than what is shown");
  get->footer("Examples:\n  " + std::string(kAppName) + " get general cmbPaperLengthUnit\n  " + kAppName +
              " get general.spinnerViewAxisSize --raw\n  " + kAppName + " get DrwPaperLengthUnit --json");
  CLI::App* set = app.add_subcommand("set", "Operate a control with a value, as a user would, and save");
  keyArgs(set, keyHelp + ", then the value: " + valueHelp, 2, 3);
  rangeOption(set);
  set->footer("Examples:\n  " + std::string(kAppName) + " set grid editorGridSpacing 2.5cm --range 2\n  " +
              kAppName + " set general.checkViewFrame off\n  " + kAppName + " set DrwPaperLengthUnit inch\n  " +
              kAppName + " set main pusStandardPLMAdd \"Supplier drafting standard\"\n  " + kAppName +
              " set main edtScaleRatio 1:50 --range 2");
  CLI::App* reset = app.add_subcommand("reset", "Put a setting back to its default (every scale range), or all");
  keyArgs(reset, keyHelp, 0, 2);
  reset->add_flag("--all", r.all, "Every setting the administrator has not locked");
  reset->footer("Examples:\n  " + std::string(kAppName) + " reset grid editorGridSpacing\n  " + kAppName +
                " reset --all");
  CLI::App* lock = app.add_subcommand(
      "lock", "Lock a setting for everyone in the administrator's file, at VALUE or at its current value");
  keyArgs(lock, keyHelp + ", then an optional value: " + valueHelp, 1, 3);
  rangeOption(lock);
  lock->footer("Examples:\n  " + std::string(kAppName) + " lock general cmbPaperLengthUnit mm\n  " + kAppName +
               " lock DrwViewFrame");
  CLI::App* unlock = app.add_subcommand("unlock", "Unlock a setting; the administrator's value stays as a default");
  keyArgs(unlock, keyHelp, 1, 2);
  unlock->footer("Example:\n  " + std::string(kAppName) + " unlock general.checkViewFrame");
  CLI::App* defaults = app.add_subcommand(
      "default", "Set the default of a setting for everyone, without locking it (or --remove it)");
  keyArgs(defaults, keyHelp + ", then the value (not with --remove): " + valueHelp, 1, 3);
  defaults->add_flag("--remove", r.remove, "Remove the administrator's default");
  rangeOption(defaults);
  defaults->footer("Examples:\n  " + std::string(kAppName) + " default general cmbPaperLengthUnit inch\n  " +
                   kAppName + " default --remove DrwPaperLengthUnit");
  CLI::App* locks = app.add_subcommand("locks", "List every lock and default of the administrator's file");
  jsonFlag(locks);
  CLI::App* list = app.add_subcommand("list", "List every setting: key, attribute, value, padlock");
  jsonFlag(list);
  CLI::App* sketcher = app.add_subcommand("sketcher", "Print the sketcher settings read from the same files");
  CLI::App* render = app.add_subcommand("render", "Draw pages as a self-contained HTML file");
  render->add_option("--html", r.html, "Output file, - for standard output")->required();
  render->add_option("pages", r.pages, "Pages to draw (default: all)");
  rangeOption(render);
  CLI::App* serve = app.add_subcommand(
      "serve", "Serve the pages as a live dialog in the browser: each change applies and is saved at once");
  serve->add_option("--port", r.port, "Port on 127.0.0.1 (default: a free one)")->check(CLI::Range(0, 65535));
  serve->add_flag("--no-open", r.noOpen, "Only print the address; do not ask the desktop to open it");
  serve->footer("Runs until interrupted (Ctrl+C). The address it prints carries a token that every request needs.");
  CLI::App* completion = app.add_subcommand("completion", "Print a completion script for a shell");
  std::string shell;
  completion->add_option("shell", shell, "bash")->required()->check(CLI::IsMember({"bash"}));
  app.footer("Exit codes: 0 done; 1 unexpected (or the output could not be written, or the catalogs are missing); "
             "2 bad command line or unknown name; 3 refused (locked or disabled); 4 a value the control does not "
             "take; 5 a settings file that cannot be read or written. serve: 0 once interrupted; 1 when it cannot listen.");

  try {
    app.parse(argc, argv);
  } catch (const CLI::ParseError& e) {
    // A mistyped command reads as unexpected arguments: name the command meant instead.
    std::vector<std::string> commands;
    for (const CLI::App* sub : app.get_subcommands([](CLI::App*) { return true; })) commands.push_back(sub->get_name());
    for (int i = 1; i < argc; ++i) {
      const std::string word = argv[i];
      if (word == "--settings" || word == "--admin" || word == "--standards" || word == "--plm-repository") {
        ++i;
        continue;
      }
      if (word.empty() || word[0] == '-') continue;
      if (std::find(commands.begin(), commands.end(), word) != commands.end()) break;
      err << "error: unknown command " << Quoted(word) << "." << DidYouMean(word, commands)
          << " Run with --help for the commands.\n";
      return kExitUsage;
    }
    const int rc = app.exit(e, out, err);
    return rc == 0 ? kExitOk : kExitUsage;
  }
  if (*pages) return ListPages(r, out);
  if (*show) return Show(r, out, err);
  if (*list) return List(r, out, err);
  if (*locks) return Locks(r, out, err);
  if (*render) return Render(r, out, err);
  if (*serve) return RunServe(ResolveSettingsPaths(r.settings, r.admin), {r.port, !r.noOpen, r.standards, r.plm}, out, err);
  if (*sketcher) return Sketcher(r, out, err);
  if (*completion) return Completion(out);
  if (*get) return TakeKey(r, 0, 0, err) ? kExitUsage : Get(r, out, err);
  if (*set) return TakeKey(r, 1, 1, err) ? kExitUsage : Set(r, out, err);
  if (*reset) {
    if (r.args.empty()) return Reset(r, out, err);
    return TakeKey(r, 0, 0, err) ? kExitUsage : Reset(r, out, err);
  }
  if (*lock) return TakeKey(r, 0, 1, err) ? kExitUsage : Administer(r, ZEPAppAdminAction::Lock, out, err);
  if (*unlock) return TakeKey(r, 0, 0, err) ? kExitUsage : Administer(r, ZEPAppAdminAction::Unlock, out, err);
  if (*defaults) {
    if (int rc = TakeKey(r, r.remove ? 0 : 1, r.remove ? 0 : 1, err)) return rc;
    return Administer(r, r.remove ? ZEPAppAdminAction::RemoveDefault : ZEPAppAdminAction::Default, out, err);
  }
  return Overview(r, out, err);
}

void CloseRepositories() {
  ZEPSysSettingRepository::CloseAll();
  ZEPSysPreferenceRepository::CloseAll();
}

} // namespace

int RunCli(int argc, const char* const* argv, std::ostream& out, std::ostream& err) {
  CloseRepositories();
  int rc = kExitFailure;
  // Without its catalogs every page would show without a single text: stop at once.
  std::error_code ec;
  const std::string resources = ZEPMsgCatalog::ResourceDir();
  if (!std::filesystem::is_directory(resources + "/catalogs", ec)) {
    err << "error: the message catalogs are missing: no folder " << resources
        << "/catalogs (ZEP_RESOURCES names the resources folder)\n";
    return kExitFailure;
  }
  try {
    rc = Run(argc, argv, out, err);
  } catch (const std::exception& ex) {
    err << "error: " << ex.what() << "\n";
    rc = kExitFailure;
  }
  CloseRepositories();
  out.flush();
  if (!out) { // a script must not take a truncated answer for a complete one
    err << "error: the output could not be written\n";
    return rc == kExitOk ? kExitFailure : rc;
  }
  return rc;
}

} // namespace zepapp
