// The settings store under concurrent saves, special files, bad stored values and faulty
// administrator's files, through the store and through the command line.
#include "SettingsFileSupport.h"
#include "ZEP2DBaseSketcherSettingsAdapt.h"
#include "ZEPAppCli.h"
#include "ZEPAppSettingsFile.h"

#include <nlohmann/json.hpp>

#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <map>
#include <random>
#include <sstream>

#include <sys/stat.h>
#include <sys/sysmacros.h>
#include <sys/wait.h>
#include <unistd.h>

using namespace zepapp;
namespace fs = std::filesystem;

namespace {

using Result = CliResult;

class SettingsStore : public SettingsFolderTest {
protected:
  void SetUp() override {
    SettingsFolderTest::SetUp();
    _u = _user.string();
    _a = _admin.string();
  }

  // In process; iArgs come after the file options.
  Result Run(const std::vector<std::string>& iArgs, bool iWithAdmin = true) {
    std::vector<std::string> args = {"--settings", _u};
    if (iWithAdmin) args.insert(args.end(), {"--admin", _a});
    args.insert(args.end(), iArgs.begin(), iArgs.end());
    return RunInProcess(args);
  }

  // The binary, under a time limit so that a command that blocks fails instead of hanging.
  // iShell runs first in the same shell (ulimit ...).
  Result RunBinary(const std::string& iSettings, const std::string& iAdmin, const std::vector<std::string>& iArgs,
                   const std::string& iShell = "") {
    std::string cmd = iShell + " exec timeout -s KILL 20 " + ShellQuote(ZEP_APP_BINARY) + " --settings " +
                      ShellQuote(iSettings) + " --admin " + ShellQuote(iAdmin);
    for (const std::string& a : iArgs) cmd += " " + ShellQuote(a);
    return RunShell(cmd, _dir);
  }

  // The file names as the command line takes them.
  std::string _u, _a;
};

// Runs iWork in iCount child processes and answers, for each, what it reported through its
// pipe (one line per successful step).
std::vector<std::string> InChildren(int iCount, const std::function<void(int, std::FILE*)>& iWork) {
  std::vector<std::pair<pid_t, int>> children;
  for (int k = 0; k < iCount; ++k) {
    int fds[2];
    if (::pipe(fds) != 0) break;
    const pid_t pid = ::fork();
    if (pid == 0) {
      ::close(fds[0]);
      std::FILE* out = ::fdopen(fds[1], "w");
      ::alarm(120); // a child that hangs dies rather than stalls the suite
      iWork(k, out);
      std::fclose(out);
      ::_exit(0);
    }
    ::close(fds[1]);
    children.emplace_back(pid, fds[0]);
  }
  std::vector<std::string> reports;
  for (auto [pid, fd] : children) {
    std::string text;
    char buffer[4096];
    for (ssize_t n; (n = ::read(fd, buffer, sizeof buffer)) > 0;) text.append(buffer, static_cast<std::size_t>(n));
    ::close(fd);
    int status = 0;
    ::waitpid(pid, &status, 0);
    EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0) << "child " << pid << " status " << status;
    reports.push_back(text);
  }
  return reports;
}

std::vector<std::string> Lines(const std::string& iText) {
  std::vector<std::string> lines;
  std::istringstream in(iText);
  for (std::string line; std::getline(in, line);) lines.push_back(line);
  return lines;
}

} // namespace

TEST_F(SettingsStore, ConcurrentSavesAndLocksLoseNothing) {
  // Each process stores attributes of its own, one save each; a reader checks the file parses.
  for (bool admin : {false, true}) {
    SCOPED_TRACE(admin ? "lock in the administrator's file" : "set in the user's file");
    const std::string file = admin ? _a : _u;
    const std::vector<std::string> reports = InChildren(8, [&](int iChild, std::FILE* oOut) {
      // One run each, saving 50 times: every save reads the file again under its lock.
      // Durability is tested elsewhere: skipping the syncs keeps 800 saves quick.
      struct NoSync : ZEPAppPosixFileOps {
        int Sync(std::FILE*) override { return 0; }
        int SyncDir(const std::string&) override { return 0; }
      };
      ZEPSysSettingRepository::CloseAll();
      ZEPAppSettingsFile store(std::make_shared<NoSync>());
      store.SetLockTimeout(60000); // what is tested here is that nothing is lost, not how long it waits
      if (FAILED(store.Load(_u, _a))) return;
      ZEPSysSettingRepository* repo = store.OpenSettings("DraftingOptions");
      for (int round = 0; round < 50; ++round) {
        // Five attributes of its own, each set ten times: the file stays small.
        const std::string attr = "P" + std::to_string(iChild) + "_" + std::to_string(round % 5);
        long rc;
        if (admin) {
          rc = store.Lock("DraftingOptions", attr, std::vector<int>{round});
        } else {
          repo->WriteAttr(attr.c_str(), &round, 1);
          rc = repo->SaveRepository();
        }
        if (SUCCEEDED(rc)) std::fprintf(oOut, "%s %d\n", attr.c_str(), round);
      }
    });
    const nlohmann::json stored = nlohmann::json::parse(ReadBytes(file));
    const nlohmann::json& repo = stored.at("settings").at("DraftingOptions");
    // The last value each run saved for each of its attributes is the one in the file.
    std::map<std::string, int> last;
    std::size_t saved = 0;
    for (const std::string& report : reports)
      for (const std::string& line : Lines(report)) {
        ++saved;
        last[line.substr(0, line.find(' '))] = std::stoi(line.substr(line.find(' ') + 1));
      }
    for (const auto& [attr, value] : last) {
      ASSERT_TRUE(repo.contains(attr)) << attr << " was saved and then lost";
      EXPECT_EQ(value, repo[attr].at("int").get<int>()) << attr << ": a later save was lost";
      if (admin) {
        EXPECT_TRUE(repo[attr].value("locked", false)) << attr;
      }
    }
    EXPECT_EQ(400u, saved) << "every save got the lock in time";
    EXPECT_EQ(40u, repo.size());
  }
}

TEST_F(SettingsStore, SaveWaitsForTheLockThenGivesUpWritingNothing) {
  ZEPAppSettingsFile store;
  store.SetLockTimeout(150);
  ASSERT_EQ(S_OK, store.Load(_u, _a));
  ZEPSysSettingRepository* repo = store.OpenSettings("DraftingOptions");
  const int one = 1;
  repo->WriteAttr("A", &one, 1);
  ASSERT_EQ(S_OK, repo->SaveRepository());
  const std::string before = ReadBytes(_u);

  ZEPAppFileLock held;
  std::string err;
  ASSERT_TRUE(held.Acquire(_u, 0, err)) << err;
  const int two = 2;
  repo->WriteAttr("A", &two, 1);
  EXPECT_LT(repo->SaveRepository(), 0);
  EXPECT_NE(std::string::npos, store.LastError().find("another process")) << store.LastError();
  ZEPAppFileLock adminHeld;
  ASSERT_TRUE(adminHeld.Acquire(_a, 0, err)) << err;
  EXPECT_LT(store.Lock("DraftingOptions", "A"), 0);
  EXPECT_NE(std::string::npos, store.LastError().find(_a + ".lock")) << store.LastError();
  EXPECT_EQ(before, ReadBytes(_u));
  EXPECT_FALSE(fs::exists(_a));

  held.Release();
  EXPECT_EQ(S_OK, repo->SaveRepository()) << store.LastError();
  EXPECT_NE(before, ReadBytes(_u));
}

TEST_F(SettingsStore, OnlyRegularFilesAreReadOrReplaced) {
  // A FIFO would block an open for reading, and replacing one would write where nobody reads.
  const fs::path fifo = _dir / "fifo.json";
  ASSERT_EQ(0, ::mkfifo(fifo.c_str(), 0600));
  for (bool asAdmin : {false, true}) {
    const std::string user = asAdmin ? _u : fifo.string(), admin = asAdmin ? fifo.string() : _a;
    for (const auto& args : {std::vector<std::string>{"show", "general"},
                             std::vector<std::string>{"set", "general", "checkViewFrame", "off"},
                             std::vector<std::string>{"lock", "DrwViewFrame"}}) {
      SCOPED_TRACE((asAdmin ? "--admin FIFO " : "--settings FIFO ") + args[0]);
      const Result r = RunBinary(user, admin, args);
      EXPECT_EQ(kExitFile, r.code) << r.err;
      EXPECT_NE(std::string::npos, r.err.find(fifo.string() + ": is a FIFO")) << r.err;
      EXPECT_TRUE(fs::is_fifo(fifo));
    }
  }

  // Character devices, and a link to one (a copy of /dev/null, and of /dev/zero that never ends).
  const fs::path null = _dir / "null", zero = _dir / "zero";
  if (::mknod(null.c_str(), S_IFCHR | 0666, makedev(1, 3)) != 0 ||
      ::mknod(zero.c_str(), S_IFCHR | 0666, makedev(1, 5)) != 0)
    GTEST_SKIP() << "cannot create character devices here (" << std::strerror(errno) << ")";
  fs::create_symlink(zero, _dir / "linked.json");
  Result r = RunBinary(null.string(), _a, {"set", "general", "checkViewFrame", "off"});
  EXPECT_EQ(kExitFile, r.code) << r.err;
  EXPECT_NE(std::string::npos, r.err.find("is a character device")) << r.err;
  EXPECT_TRUE(fs::is_character_file(null)) << "the device was replaced";
  r = RunBinary((_dir / "linked.json").string(), _a, {"get", "general", "checkViewFrame"});
  EXPECT_EQ(kExitFile, r.code) << r.err;
  EXPECT_TRUE(fs::is_symlink(_dir / "linked.json"));

  // Reads are bounded however large the file is: a sparse file of 17 MiB.
  {
    std::ofstream(_u, std::ios::binary) << "{";
  }
  fs::resize_file(_u, 17u << 20);
  ZEPAppSettingsFile store;
  EXPECT_EQ(E_FAIL, store.Load(_u));
  EXPECT_NE(std::string::npos, store.LastError().find("too large")) << store.LastError();
}

TEST_F(SettingsStore, TemporaryFilesAreUnpredictableAndStaleOnesGo) {
  // Names a killed save left: an old pid-numbered one, and one of the random kind.
  WriteBytes(_dir / (".settings.json.tmp." + std::to_string(::getpid()) + ".1"), "{");
  WriteBytes(_dir / ".settings.json.tmp.k3J9aQ0pLm2x", "{\"format\"");
  WriteBytes(_dir / ".other.json.tmp.k3J9aQ0pLm2x", "kept: another file's");

  // The first name tried is taken: the save tries another.
  struct Colliding : ZEPAppPosixFileOps {
    std::vector<std::string> names;
    int Create(const std::string& p, int m, std::FILE*& f) override {
      names.push_back(p);
      return names.size() == 1 ? EEXIST : ZEPAppPosixFileOps::Create(p, m, f);
    }
  };
  auto ops = std::make_shared<Colliding>();
  ZEPAppSettingsFile store(ops);
  ASSERT_EQ(S_OK, store.Load(_u));
  ZEPSysSettingRepository* repo = store.OpenSettings("DraftingOptions");
  const int one = 1;
  repo->WriteAttr("A", &one, 1);
  ASSERT_EQ(S_OK, repo->SaveRepository()) << store.LastError();
  ASSERT_EQ(2u, ops->names.size());
  EXPECT_NE(ops->names[0], ops->names[1]);
  for (const std::string& name : ops->names)
    EXPECT_EQ(std::string::npos, name.find(std::to_string(::getpid()))) << name;

  std::set<std::string> left;
  for (const auto& e : fs::directory_iterator(_dir)) left.insert(e.path().filename().string());
  EXPECT_EQ((std::set<std::string>{"settings.json", "settings.json.lock", ".other.json.tmp.k3J9aQ0pLm2x"}), left);
}

TEST_F(SettingsStore, StoredValuesAreCheckedAgainstTheirControls) {
  const std::string text = "{\"settings\": {\n"
                           " \"DraftingOptions\": {\n"
                           "  \"DrwViewAxisLength\": {\"int\": 5},\n"
                           "  \"DrwDefaultOffsetBetViews\": {\"double\": -5},\n"
                           "  \"DrwPaperLengthUnit\": {\"int\": 99},\n"
                           "  \"DrwViewFrame\": {\"int\": 2},\n"
                           "  \"DrwViewAxisLenght\": {\"double\": 10}},\n"
                           " \"DrwSketcherSpecific\": {\n"
                           "  \"Drw_settings_GridSecondaryStep\": {\"int\": [0, -5, 10, 10, 10]},\n"
                           "  \"Drw_settings_GridPrimarySpacing\": {\"int\": [1, 2, 3, 4, 5]},\n"
                           "  \"Drw_settings_GridVPrimarySpacing\": {\"double\": [10, 20]}}}}\n";
  WriteBytes(_u, text);
  Result r = Run({"show", "general"});
  ASSERT_EQ(kExitOk, r.code) << r.err;
  for (const char* expected : {":3:32: settings/DraftingOptions/DrwViewAxisLength: holds \"int\" values, expected "
                               "\"double\"; the default is used instead",
                               ":4:42: settings/DraftingOptions/DrwDefaultOffsetBetViews: -5 is outside",
                               ":5:33: settings/DraftingOptions/DrwPaperLengthUnit: 99 is outside the control's "
                               "limits (one of 1 3 5)",
                               ":6:27: settings/DraftingOptions/DrwViewFrame: 2 is not a check state",
                               ":7:3: settings/DraftingOptions/DrwViewAxisLenght: unknown attribute",
                               ":9:45: settings/DrwSketcherSpecific/Drw_settings_GridSecondaryStep: value 1: 0 is",
                               ":10:46: settings/DrwSketcherSpecific/Drw_settings_GridPrimarySpacing: holds \"int\"",
                               ":11:50: settings/DrwSketcherSpecific/Drw_settings_GridVPrimarySpacing: holds 2 "
                               "values, expected 5"})
    EXPECT_NE(std::string::npos, r.err.find("warning: " + _u + std::string(expected))) << expected << "\n"
                                                                                         << r.err;
  EXPECT_NE(std::string::npos, r.out.find("50 mm")) << "the default shows: " << r.out;
  EXPECT_EQ("10\n", Run({"get", "grid", "editorGridGraduation", "--range", "1"}).out);

  // A change writes only itself: the values that are not used stay as they were.
  r = Run({"set", "general", "checkViewRefZoom", "on"});
  ASSERT_EQ(kExitOk, r.code) << r.err;
  nlohmann::json stored = nlohmann::json::parse(ReadBytes(_u));
  EXPECT_EQ(5, stored["settings"]["DraftingOptions"]["DrwViewAxisLength"]["int"]);
  EXPECT_EQ(99, stored["settings"]["DraftingOptions"]["DrwPaperLengthUnit"]["int"]);
  EXPECT_EQ(10.0, stored["settings"]["DraftingOptions"]["DrwViewAxisLenght"]["double"]);
  EXPECT_EQ(1, stored["settings"]["DraftingOptions"]["DrwViewAxisZoom"]["int"]);
  // Setting one of them replaces it; resetting one drops it from the file.
  ASSERT_EQ(kExitOk, Run({"set", "general", "spinnerViewAxisSize", "40"}).code);
  ASSERT_EQ(kExitOk, Run({"reset", "general", "cmbPaperLengthUnit"}).code);
  stored = nlohmann::json::parse(ReadBytes(_u));
  EXPECT_EQ(40.0, stored["settings"]["DraftingOptions"]["DrwViewAxisLength"]["double"]);
  EXPECT_FALSE(stored["settings"]["DraftingOptions"].contains("DrwPaperLengthUnit"));

  // A user's value of a locked setting is reported and the administrator's value shows.
  WriteBytes(_a, "{\"settings\": {\"DraftingOptions\": {\"DrwViewAxisLength\": {\"double\": 30, \"locked\": true}}}}");
  r = Run({"get", "general", "spinnerViewAxisSize"});
  EXPECT_EQ("30 mm\n", r.out);
  EXPECT_NE(std::string::npos, r.err.find("DrwViewAxisLength: is locked")) << r.err;
}

TEST_F(SettingsStore, FaultyAdministratorsFileStopsEveryWrite) {
  WriteBytes(_u, "{}");
  const std::vector<std::pair<std::string, std::string>> faults = {
      {"{\"settings\": {\"DraftingOptions\": {\"DrwViewFrame\": {\"int\": 0, \"locked\": true},\n"
       "  \"DrwPaperUnit\": {\"int\": 1, \"locked\": true}}}}",
       ":2:3: settings/DraftingOptions/DrwPaperUnit: unknown attribute"},
      {"{\"settings\": {\"DraftingOptions\": {\"DrwViewFrame\": {\"int\": 0, \"locked\": true},\n"
       "  \"DrwViewAxisLength\": {\"int\": 5, \"locked\": true}}}}",
       ":2:32: settings/DraftingOptions/DrwViewAxisLength: holds \"int\" values"},
      {"{\"settings\": {\"DraftingOptions\": {\"DrwViewFrame\": {\"int\": 0, \"locked\": true},\n"
       "  \"DrwViewAxisZoom\": {\"int\": 1, \"locked\": \"yes\"}}}}",
       ":2:43: settings/DraftingOptions/DrwViewAxisZoom: \"locked\" must be true or false"},
  };
  for (const auto& [text, says] : faults) {
    SCOPED_TRACE(says);
    WriteBytes(_a, text);
    for (const auto& args : {std::vector<std::string>{"set", "general", "checkViewRefZoom", "on"},
                             std::vector<std::string>{"reset", "--all"},
                             std::vector<std::string>{"lock", "DrwViewAxisZoom"},
                             std::vector<std::string>{"unlock", "DrwViewFrame"}}) {
      const Result r = Run(args);
      EXPECT_EQ(kExitFile, r.code) << args[0];
      EXPECT_NE(std::string::npos, r.err.find("error: " + _a + says)) << r.err;
    }
    EXPECT_EQ("{}", ReadBytes(_u));
    EXPECT_EQ(text, ReadBytes(_a));

    // Reads warn, and the locks that could be read still hold.
    const Result show = Run({"show", "general"});
    EXPECT_EQ(kExitOk, show.code);
    EXPECT_NE(std::string::npos, show.err.find("warning: " + _a + says)) << show.err;
    EXPECT_NE(std::string::npos, show.err.find("no change is accepted")) << show.err;
    EXPECT_NE(std::string::npos, show.out.find("Locked by an administrator")) << show.out;
    const fs::path html = _dir / "pages.html";
    ASSERT_EQ(kExitOk, Run({"render", "--html", html.string()}).code);
    EXPECT_NE(std::string::npos, ReadBytes(html).find("role=\"alert\""));
  }
}

TEST_F(SettingsStore, SystemWideLocksApplyWithoutOptionOrEnvironment) {
  const fs::path system = _dir / "xdg";
  fs::create_directories(system / "drafting-options");
  WriteBytes(system / "drafting-options" / "admin.json",
             "{\"settings\": {\"DraftingOptions\": {\"DrwViewFrame\": {\"int\": 0, \"locked\": true, \"by\": \"it\"}}}}");
  const char* old = std::getenv("XDG_CONFIG_DIRS");
  const std::string saved = old ? old : "";
  setenv("XDG_CONFIG_DIRS", system.c_str(), 1);
  unsetenv(kAdminFileEnv);
  const Result set = Run({"set", "general", "checkViewFrame", "on"}, false);
  const Result show = Run({"get", "general", "checkViewFrame"}, false);
  if (old) setenv("XDG_CONFIG_DIRS", saved.c_str(), 1);
  else unsetenv("XDG_CONFIG_DIRS");
  EXPECT_EQ(kExitRefused, set.code) << set.err;
  EXPECT_NE(std::string::npos, set.err.find("Locked by it")) << set.err;
  EXPECT_EQ("off\n", show.out);
  EXPECT_FALSE(fs::exists(_u));
}

TEST_F(SettingsStore, FileSizeLimitAndMissingFoldersFailWithAMessage) {
  // Enough content that a save exceeds one block.
  std::string text = "{\"preferences\": {\"Pad\": {";
  for (int i = 0; i < 100; ++i) text += (i ? "," : "") + std::string("\"X") + std::to_string(i) + "\": {\"int\": 1}";
  text += "}}}";
  WriteBytes(_u, text);
  const Result r = RunBinary(_u, _a, {"set", "general", "checkViewFrame", "off"}, "ulimit -f 1;");
  EXPECT_EQ(kExitFile, r.code) << r.err;
  EXPECT_NE(std::string::npos, r.err.find("File too large")) << r.err;
  EXPECT_EQ(text, ReadBytes(_u));
  for (const auto& e : fs::directory_iterator(_dir))
    EXPECT_EQ(std::string::npos, e.path().filename().string().find(".tmp.")) << e.path();

  const fs::path missing = _dir / "missing" / "x.html";
  const Result render = Run({"render", "--html", missing.string()});
  EXPECT_EQ(kExitFile, render.code);
  EXPECT_NE(std::string::npos, render.err.find("does not exist")) << render.err;
  EXPECT_FALSE(fs::exists(missing.parent_path()));
}

TEST_F(SettingsStore, DispatchSurvivesCallbacksThatUnsubscribeOrDestroy) {
  struct Adapter : ZEP2DBaseSketcherSettingsAdapt {
    void Use(ZEPSysSettingRepository* iSpecific) { _pSpecificSettRep = iSpecific; }
    unsigned int GetDefaultColorDiagElts(ZEP2DCstDiag) override { return 0; }
  };
  auto* adapter = new Adapter;
  std::vector<std::string> calls;
  ZEPCallbackManager::CallbackId second = 0;
  adapter->AddCallback("E", [&](const char*, ZEPNotification*, void*) {
    calls.push_back("first");
    adapter->RemoveCallback(second);
  });
  second = adapter->AddCallback("E", [&](const char*, ZEPNotification*, void*) { calls.push_back("second"); });
  adapter->AddCallback("E", [&](const char*, ZEPNotification*, void*) {
    calls.push_back("third");
    delete adapter; // the subscriber goes, and the manager with it
  });
  adapter->AddCallback("E", [&](const char*, ZEPNotification*, void*) { calls.push_back("fourth"); });
  adapter->DispatchCallbacks("E", nullptr, nullptr);
  EXPECT_EQ((std::vector<std::string>{"first", "third"}), calls);

  // Spacings of 0 or less and graduations below 1 never reach the sketcher.
  Adapter sketcher;
  ZEPSysSettingRepository* specific = ZEPSysSettingRepository::Open("SketcherSpecific");
  sketcher.Use(specific);
  // As a file or another program may have stored them.
  specific->SetUserValue(ZEP2DBaseSketcherSettingsAdapt::mstrGridHPrSpacing,
                         std::vector<double>{0.0, -3.0, 7.0, std::nan(""), 0.5});
  specific->SetUserValue(ZEP2DBaseSketcherSettingsAdapt::mstrGridVSecStep, std::vector<int>{0, -5, 4, 1, 10});
  const double expected[5] = {100.0, 10000.0, 7.0, 1.0, 0.5};
  const int expectedSteps[5] = {10, 10, 4, 1, 10};
  for (int range = 1; range <= 5; ++range) {
    EXPECT_EQ(expected[range - 1], sketcher.GetGridPrimSpac(static_cast<ZEPCkeScale>(range))) << range;
    EXPECT_EQ(expectedSteps[range - 1], sketcher.GetGridVSecStep(static_cast<ZEPCkeScale>(range))) << range;
  }
}

// Saves after the first rewrite only the entries they change: whatever a run does, each save
// leaves the file a whole save would write, holding what the run and other writers set.
TEST_F(SettingsStore, SavesInOneRunWriteWhatAWholeSaveWrites) {
  std::mt19937 random(5u);
  auto name = [](int k) { return "Attr" + std::to_string(k); };
  std::map<std::string, ZEPAppValue> expected; // the repository's part of the file
  std::map<std::string, int> foreign;          // what another process keeps in another repository
  auto check = [&](int step) {
    SCOPED_TRACE("step " + std::to_string(step));
    const std::string text = ReadBytes(_user);
    ZEPAppSettingsDoc doc;
    ASSERT_TRUE(ParseSettingsText(text, _u, false, doc).empty()) << text;
    std::string whole, err;
    ASSERT_TRUE(FormatSettingsText(doc, false, whole, err)) << err;
    ASSERT_EQ(whole, text);
    std::map<std::string, ZEPAppValue> mine;
    for (const auto& [attr, entry] : doc.settings["R"]) mine.emplace(attr, *entry.value);
    ASSERT_EQ(expected, mine);
    for (const auto& [attr, v] : foreign) ASSERT_EQ(ZEPAppValue(std::vector<int>{v}), *doc.settings["Other"][attr].value);
  };
  ZEPAppSettingsFile store;
  ASSERT_EQ(S_OK, store.Load(_u));
  ZEPSysSettingRepository* repo = store.OpenSettings("R");
  for (int step = 0; step < 60; ++step) {
    const std::string attr = name(static_cast<int>(random() % 12));
    switch (random() % 6) {
    case 0: case 1: { // a value of another kind or count now and then
      const int v = static_cast<int>(random() % 1000) - 500;
      if (random() % 2) {
        ASSERT_EQ(1, repo->WriteAttr(attr.c_str(), &v, 1));
        expected[attr] = std::vector<int>{v};
      } else {
        const double d[3] = {v / 8.0, 0.1, -1e-7};
        const int n = 1 + static_cast<int>(random() % 3);
        ASSERT_EQ(1, repo->WriteAttr(attr.c_str(), d, n));
        expected[attr] = std::vector<double>(d, d + n);
      }
      break;
    }
    case 2: { // a text that needs escapes
      const std::vector<std::string> texts = {"a\"b\\c\n" + attr, "\xE6\x97\xA5"};
      ASSERT_EQ(1, repo->WriteAttr(attr.c_str(), texts));
      expected[attr] = texts;
      break;
    }
    case 3:
      ASSERT_EQ(S_OK, store.Reset("R", attr));
      expected.erase(attr);
      break;
    case 4: { // more writes at once than the repository keeps track of
      for (int k = 0; k < 80; ++k) {
        const int v = step * 100 + k;
        ASSERT_EQ(1, repo->WriteAttr(("Many" + std::to_string(k)).c_str(), &v, 1));
        expected["Many" + std::to_string(k)] = std::vector<int>{v};
      }
      break;
    }
    default: { // another process saves meanwhile
      ZEPAppSettingsDoc doc;
      ParseSettingsText(ReadBytes(_user), _u, false, doc);
      const std::string key = "F" + std::to_string(random() % 4);
      foreign[key] = step;
      doc.settings["Other"][key].value = std::vector<int>{step};
      std::string text, err;
      ASSERT_TRUE(FormatSettingsText(doc, false, text, err));
      WriteBytes(_user, text);
      continue;
    }
    }
    ASSERT_EQ(S_OK, repo->SaveRepository()) << store.LastError();
    check(step);
    if (HasFailure()) return;
  }
  // A second run reads back what the last save wrote.
  ZEPSysSettingRepository::CloseAll();
  ZEPAppSettingsFile again;
  ASSERT_EQ(S_OK, again.Load(_u));
  EXPECT_EQ(expected, again.OpenSettings("R")->UserValues());
}

// Changes of the administrator's file made together go in one write: all of them or none.
TEST_F(SettingsStore, AdministeredTogetherOrNotAtAll) {
  struct CountingOps : ZEPAppPosixFileOps {
    int renames = 0;
    bool fail = false;
    int Rename(const std::string& iFrom, const std::string& iTo) override {
      if (fail) return EIO;
      ++renames;
      return ZEPAppPosixFileOps::Rename(iFrom, iTo);
    }
  };
  auto ops = std::make_shared<CountingOps>();
  ZEPAppSettingsFile store(ops);
  ASSERT_EQ(S_OK, store.Load(_u, _a));
  ZEPSysSettingRepository* repo = store.OpenSettings("R");
  const std::vector<ZEPAppAdminEdit> group = {{ZEPAppAdminAction::Lock, "R", "A", std::vector<int>{1}},
                                              {ZEPAppAdminAction::Lock, "R", "B", std::nullopt},
                                              {ZEPAppAdminAction::Default, "R", "C", std::vector<std::string>{"x"}}};
  ops->fail = true; // the disk refuses: neither the file nor the repository changes
  EXPECT_EQ(E_FAIL, store.Administer(group));
  EXPECT_FALSE(fs::exists(_admin));
  EXPECT_FALSE(repo->IsLocked("A") || repo->IsLocked("B") || repo->Effective("C"));
  ops->fail = false;
  ASSERT_EQ(S_OK, store.Administer(group)) << store.LastError();
  EXPECT_EQ(1, ops->renames);
  EXPECT_TRUE(repo->IsLocked("A") && repo->IsLocked("B"));
  ASSERT_TRUE(repo->Effective("C"));
  EXPECT_EQ(ZEPAppValue(std::vector<std::string>{"x"}), *repo->Effective("C"));

  // One change that cannot be made stops those before it too.
  const std::string written = ReadBytes(_admin);
  EXPECT_EQ(E_FAIL, store.Administer({{ZEPAppAdminAction::Unlock, "R", "A", std::nullopt},
                                      {ZEPAppAdminAction::RemoveDefault, "R", "B", std::nullopt}}));
  EXPECT_TRUE(Has(store.LastError(), "B is locked: unlock it first"));
  EXPECT_EQ(written, ReadBytes(_admin));
  EXPECT_TRUE(repo->IsLocked("A"));
  // Nothing to do for any of them writes nothing; something to do for one writes once.
  const std::vector<ZEPAppAdminEdit> unlock = {{ZEPAppAdminAction::Unlock, "R", "C", std::nullopt},
                                               {ZEPAppAdminAction::Unlock, "R", "A", std::nullopt}};
  EXPECT_EQ(1, store.Administer({unlock.front()}));
  EXPECT_EQ(S_OK, store.Administer(unlock));
  EXPECT_EQ(2, ops->renames);
  EXPECT_FALSE(repo->IsLocked("A"));
  EXPECT_TRUE(repo->IsLocked("B"));
}
