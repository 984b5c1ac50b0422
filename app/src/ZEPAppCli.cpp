#include "ZEPAppCli.h"

#include "ZEPAppInfo.h"
#include "ZEPAppPages.h"
#include "ZEPAppRender.h"
#include "ZEPAppSettingsFile.h"
#include "ZEPAppSketcher.h"

#include <CLI/CLI.hpp>

#include <algorithm>
#include <cctype>
#include <filesystem>
#include <map>
#include <memory>

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
  std::string settings, admin;
  std::string page, control, value, attribute, html;
  std::vector<std::string> pages;
  int range = 0; // 0: the range the grid page opens on
  bool all = false;
};

// One run of the application: the settings files, the repositories bound to them and the
// pages opened on a top-level window.
class Session {
public:
  Session(std::ostream& out, std::ostream& err) : _out(out), _err(err) {}
  ~Session() {
    _pRoot.reset(); // the pages go before the repositories they are bound to
    ZEPDlgDriver::Idle();
  }

  // Loads the files. A faulty file is reported; a command that writes stops there.
  int Start(const Request& iRequest, bool iWrites) {
    _paths = ResolveSettingsPaths(iRequest.settings, iRequest.admin);
    const long rc = _file.Load(_paths.user, _paths.admin);
    for (const std::string& name : AppRepositories())
      _file.OpenSettings(name);
    ApplyDefaults();
    _pRoot = std::make_unique<ZEPDlgWindow>(nullptr, "DraftingOptions", 0);
    if (SUCCEEDED(rc)) return kExitOk;
    for (const ZEPAppFileError& e : _file.LoadErrors())
      _err << (iWrites ? "error: " : "warning: ") << e.Text() << "\n";
    if (iWrites) {
      _err << "error: nothing was changed; correct or remove the faulty file, then try again\n";
      return kExitFile;
    }
    _err << "warning: the values shown leave the faulty file out\n";
    return kExitOk;
  }

  // The page of that name, or null after listing the valid ones.
  const ZEPAppPage* Page(const std::string& iName) {
    if (const ZEPAppPage* page = FindPage(Lower(iName))) return page;
    _err << "error: unknown page " << Quoted(iName) << "; the pages are:";
    for (const ZEPAppPage& p : AppPages())
      _err << " " << p.name;
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
      _err << "error: --range applies to the grid page only\n";
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
    _err << "error: unknown control " << Quoted(iName) << " on page " << iPage.name
         << "; its controls are:\n";
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
    std::size_t nameWidth = 0, titleWidth = 0, valueWidth = 0;
    for (const ZEPAppControl& c : iControls) {
      nameWidth = std::max(nameWidth, c.name.size());
      titleWidth = std::max(titleWidth, TextWidth(c.Title()));
      valueWidth = std::max(valueWidth, TextWidth(c.Shown()));
    }
    std::string section = "\x01"; // no section yet
    for (const ZEPAppControl& c : iControls) {
      if (c.section != section) {
        section = c.section;
        if (!section.empty()) _out << "  " << section << "\n";
      }
      std::string marks;
      if (c.Kind() == ZEPAppKind::Push) marks += "  (button: opens a dialog)";
      if (c.Locked())
        marks += "  \xF0\x9F\x94\x92 " + c.LockText();
      else if (c.Disabled())
        marks += "  (disabled)";
      std::string line = "    ";
      if (iWithNames) line += Pad(c.name, nameWidth) + "  ";
      line += Pad(c.Title(), titleWidth) + "  " +
              (marks.empty() ? c.Shown() : Pad(c.Shown(), valueWidth) + marks);
      _out << line << "\n";
    }
  }

  ZEPAppSettingsFile& File() { return _file; }
  const ZEPAppSettingsPaths& Paths() const { return _paths; }

private:
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

int ListPages(std::ostream& out) {
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
  session.Print(*page, controls, true);
  return kExitOk;
}

int Get(const Request& iRequest, std::ostream& out, std::ostream& err) {
  Session session(out, err);
  const ZEPAppPage* page = nullptr;
  std::vector<ZEPAppControl> controls;
  const ZEPAppControl* control = nullptr;
  if (int rc = session.Target(iRequest, false, page, controls, &control)) return rc;
  out << control->Shown() << "\n";
  return kExitOk;
}

// The stored setting behind a control, from the settings table; null for a control that only
// changes what the page shows (the scale range, a push button).
const ZEPAppSetting* SettingOf(const ZEPAppPage& iPage, const ZEPAppControl& iControl) {
  for (const ZEPAppSetting& s : AppSettings())
    if (iPage.Shows(s) && s.control == iControl.name) return &s;
  return nullptr;
}

int Set(const Request& iRequest, std::ostream& out, std::ostream& err) {
  Session session(out, err);
  const ZEPAppPage* page = nullptr;
  std::vector<ZEPAppControl> controls;
  const ZEPAppControl* control = nullptr;
  if (int rc = session.Target(iRequest, true, page, controls, &control)) return rc;
  const ZEPAppOutcome outcome = OperateControl(controls, *control, iRequest.value);
  const int range = ShownRange(controls);
  CloseSubDialog(*control); // as the user closes the dialog the change was made in
  if (outcome.code != kExitOk) {
    err << "error: " << outcome.message << "\nnothing was changed\n";
    return outcome.code;
  }
  if (outcome.changed && FAILED(session.File().SaveAll())) {
    err << "error: the change was not saved: " << session.File().LastError() << "\n";
    return kExitFile;
  }
  out << outcome.message;
  const ZEPAppSetting* setting = SettingOf(*page, *control);
  if (setting && setting->defaults.size() > 1 && range)
    out << "  (scale range " << range << ": " << ScaleName(range) << ")";
  if (!setting && !control->opensNewerDialog)
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
  const ZEPAppSetting* setting = SettingOf(*page, *control);
  if (!setting) {
    err << "error: " << Quoted(control->Title()) << " (" << control->name
        << ") keeps no setting of its own\n";
    return kExitUsage;
  }
  ZEPSysSettingRepository* repo =
      ZEPSysSettingRepository::GetRepository(setting->repository.c_str());
  ZEPSettingInfo info;
  if (repo && repo->IsLocked(setting->stored) &&
      SUCCEEDED(repo->GetLockInfo(setting->stored, info))) {
    err << "error: " << Quoted(control->Title()) << " is locked: "
        << (info.GetLockText().empty() ? "Locked by an administrator" : info.GetLockText())
        << "\nnothing was changed\n";
    return kExitRefused;
  }
  const std::string name = control->name, title = control->Title();
  if (FAILED(session.File().Reset(setting->repository, setting->stored))) {
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

const ZEPAppSetting* Attribute(const std::string& iName, std::ostream& err) {
  for (const ZEPAppSetting& s : AppSettings())
    if (s.stored == iName) return &s;
  for (const ZEPAppSetting& s : AppSettings())
    if (Lower(s.stored) == Lower(iName)) return &s;
  err << "error: unknown attribute " << Quoted(iName) << "; the attributes are:\n";
  std::size_t width = 0;
  for (const ZEPAppSetting& s : AppSettings())
    width = std::max(width, s.stored.size());
  for (const ZEPAppSetting& s : AppSettings()) {
    std::string page = s.page;
    for (const ZEPAppPage& p : AppPages())
      if (p.table == s.page) page = p.name;
    err << "  " << Pad(s.stored, width) << "  " << page << " " << s.control << "\n";
  }
  return nullptr;
}

int LockOrUnlock(const Request& iRequest, bool iLock, std::ostream& out, std::ostream& err) {
  const ZEPAppSetting* setting = Attribute(iRequest.attribute, err);
  if (!setting) return kExitUsage;
  Session session(out, err);
  if (int rc = session.Start(iRequest, true)) return rc;
  if (session.Paths().admin.empty()) {
    err << "error: no administrator's file: give --admin FILE or set " << kAdminFileEnv << "\n";
    return kExitUsage;
  }
  const long rc = iLock ? session.File().Lock(setting->repository, setting->stored)
                        : session.File().Unlock(setting->repository, setting->stored);
  if (FAILED(rc)) {
    err << "error: " << session.File().LastError() << "\n";
    return kExitFile;
  }
  if (!iLock && rc == 1) {
    out << setting->stored << " was not locked; nothing changed\n";
    return kExitOk;
  }
  // What the page shows now, padlock included.
  std::string shown;
  for (const ZEPAppPage& p : AppPages())
    if (p.table == setting->page) {
      const std::vector<ZEPAppControl> controls = PageControls(session.Open(p), p.dialogButtons);
      if (const ZEPAppControl* c = FindPageControl(controls, setting->control))
        shown = c->Title() + " (" + p.name + " " + c->name + ") = " + c->Shown();
    }
  out << (iLock ? "Locked " : "Unlocked ") << setting->stored << " in "
      << session.File().AdminPath() << "\n";
  if (!shown.empty()) out << "  " << shown << "\n";
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
    std::string note;
    if (ShownRange(controls)) {
      if (int rc = session.Controls(*page, iRequest.range, controls)) return rc;
      ranged = true;
      note = "Spacing and graduations of the " + ScaleName(ShownRange(controls)) + " scale range";
    }
    ZEPAppRenderPage shown{page->name, page->title, session.Open(*page), note, {}};
    for (const ZEPAppControl& c : controls)
      if (c.opener && (shown.dialogs.empty() || shown.dialogs.back().dialog != c.subDialog))
        shown.dialogs.push_back({c.opener, c.subDialog});
    rendered.push_back(shown);
  }
  if (iRequest.range && !ranged) {
    err << "error: --range applies to the grid page only\n";
    return kExitUsage;
  }
  ZEPAppRenderContext context{session.Paths().user, session.Paths().admin,
                              std::string(kAppName) + " " + kAppVersion};
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
  app.set_version_flag("--version", std::string(kAppName) + " " + kAppVersion);
  Request r;
  app.add_option("--settings", r.settings,
                 "The user's settings file (default: $" + std::string(kSettingsFileEnv) +
                     ", else $XDG_CONFIG_HOME or ~/.config, drafting-options/settings.json)");
  app.add_option("--admin", r.admin,
                 "The administrator's settings file: defaults and locks (default: $" +
                     std::string(kAdminFileEnv) + ", else none)");
  auto rangeOption = [&r](CLI::App* cmd) {
    cmd->add_option("--range", r.range, "Grid page: the scale range to work on, 1 to 5")
        ->check(CLI::Range(1, 5));
  };

  CLI::App* pages = app.add_subcommand("pages", "List the pages");
  CLI::App* show =
      app.add_subcommand("show", "Show a page: each control's name, title, value and padlock");
  show->add_option("page", r.page, "Page name")->required();
  rangeOption(show);
  CLI::App* get = app.add_subcommand("get", "Print the value a control shows");
  get->add_option("page", r.page, "Page name")->required();
  get->add_option("control", r.control, "Control name (see show)")->required();
  rangeOption(get);
  CLI::App* set =
      app.add_subcommand("set", "Operate a control with a value, as a user would, and save");
  set->add_option("page", r.page, "Page name")->required();
  set->add_option("control", r.control, "Control name (see show)")->required();
  set->add_option(
         "value", r.value,
         "on/off for a check box; a number with an optional unit (25mm, 2.5cm, 1in, 15deg) for a "
         "spinner; a line number from 1 or a line's text for a combo or a group of radio buttons")
      ->required();
  rangeOption(set);
  CLI::App* reset =
      app.add_subcommand("reset", "Put a setting back to its default (every scale range), or all");
  reset->add_option("page", r.page, "Page name");
  reset->add_option("control", r.control, "Control name (see show)");
  reset->add_flag("--all", r.all, "Every setting the administrator has not locked");
  CLI::App* lock =
      app.add_subcommand("lock", "Lock a setting at its current value in the administrator's file");
  lock->add_option("attribute", r.attribute, "Stored attribute name, such as DrwPaperLengthUnit")
      ->required();
  CLI::App* unlock = app.add_subcommand("unlock", "Unlock a setting in the administrator's file");
  unlock->add_option("attribute", r.attribute, "Stored attribute name")->required();
  CLI::App* sketcher =
      app.add_subcommand("sketcher", "Print the sketcher settings read from the same files");
  CLI::App* render = app.add_subcommand("render", "Draw pages as a self-contained HTML file");
  render->add_option("--html", r.html, "Output file, - for standard output")->required();
  render->add_option("pages", r.pages, "Pages to draw (default: all)");
  rangeOption(render);

  try {
    app.parse(argc, argv);
  } catch (const CLI::ParseError& e) {
    const int rc = app.exit(e, out, err);
    return rc == 0 ? kExitOk : kExitUsage;
  }
  if (*pages) return ListPages(out);
  if (*show) return Show(r, out, err);
  if (*get) return Get(r, out, err);
  if (*set) return Set(r, out, err);
  if (*reset) return Reset(r, out, err);
  if (*lock) return LockOrUnlock(r, true, out, err);
  if (*unlock) return LockOrUnlock(r, false, out, err);
  if (*render) return Render(r, out, err);
  if (*sketcher) return Sketcher(r, out, err);
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
  try {
    rc = Run(argc, argv, out, err);
  } catch (const std::exception& ex) {
    err << "error: " << ex.what() << "\n";
    rc = kExitFailure;
  }
  CloseRepositories();
  out.flush();
  return rc;
}

} // namespace zepapp
