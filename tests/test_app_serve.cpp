// drafting-options serve: the server running in-process on a free port, spoken to over HTTP
// as the page's script does; the command line's binary for changes made elsewhere and for
// the command's own life (its address, SIGTERM).
#include "SettingsFileSupport.h"
#include "ZEPAppControls.h"
#include "ZEPAppServe.h"

#include <httplib.h>
#include <nlohmann/json.hpp>

#include <csignal>
#include <thread>

#include <sys/wait.h>
#include <unistd.h>

using namespace zepapp;
namespace fs = std::filesystem;

namespace {

const char* const kSnapLocked = R"({"format": 1, "settings": {"DrwSketcherSpecific": {
  "Drw_settings_GridSnapPt": {"int": 1, "locked": true, "by": "cad-admin"}}}, "preferences": {}})";

class ServeTest : public SettingsFolderTest {
protected:
  void SetUp() override {
    SettingsFolderTest::SetUp();
    _pServer = std::make_unique<ZEPAppServer>(ZEPAppSettingsPaths{_user.string(), _admin.string()});
    std::string error;
    ASSERT_TRUE(_pServer->Start(0, error)) << error;
  }
  void TearDown() override {
    _pServer.reset(); // stopped before the host is reset under it
    SettingsFolderTest::TearDown();
  }

  httplib::Client Client() const {
    httplib::Client client("127.0.0.1", _pServer->Port());
    client.set_default_headers({{"X-Token", _pServer->Token()}});
    return client;
  }
  // The answer of a POST, its body parsed; fails the test when the status is not iStatus.
  nlohmann::json Post(const std::string& iPath, const std::string& iBody, int iStatus = 200) const {
    httplib::Result r = Client().Post(iPath.c_str(), iBody, "application/json");
    if (!r) {
      ADD_FAILURE() << "no answer to " << iPath;
      return nullptr;
    }
    EXPECT_EQ(r->status, iStatus) << r->body;
    return nlohmann::json::parse(r->body, nullptr, false);
  }
  nlohmann::json Change(const std::string& iPage, const std::string& iControl, const std::string& iValue,
                        const nlohmann::json& iRanges = nlohmann::json::object()) const {
    return Post("/api/change",
                nlohmann::json{{"page", iPage}, {"control", iControl}, {"value", iValue}, {"ranges", iRanges}}.dump());
  }
  nlohmann::json State(const nlohmann::json& iRanges = nlohmann::json::object()) const {
    return Post("/api/state", nlohmann::json{{"ranges", iRanges}}.dump());
  }
  static nlohmann::json Control(const nlohmann::json& iState, const std::string& iPage, const std::string& iName) {
    for (const auto& page : iState.at("pages"))
      if (page.at("page") == iPage)
        for (const auto& c : page.at("controls"))
          if (c.at("control") == iName) return c;
    ADD_FAILURE() << iPage << "." << iName << " is not in the state";
    return nlohmann::json::object();
  }
  static nlohmann::json Page(const nlohmann::json& iState, const std::string& iPage) {
    for (const auto& page : iState.at("pages"))
      if (page.at("page") == iPage) return page;
    return nlohmann::json::object();
  }
  nlohmann::json Stored(const std::string& iRepository, const std::string& iAttribute) const {
    const nlohmann::json file = nlohmann::json::parse(ReadBytes(_user));
    const nlohmann::json& entry = file.at("settings").at(iRepository).at(iAttribute);
    return entry.contains("int") ? entry["int"] : entry.at("double");
  }
  // The command line's binary on the same files.
  int RunBinary(const std::string& iArgs) const {
    const std::string files = " --settings " + ShellQuote(_user.string()) + " --admin " + ShellQuote(_admin.string());
    return RunShell(ShellQuote(ZEP_APP_BINARY) + files + " " + iArgs, _dir).code;
  }

  std::unique_ptr<ZEPAppServer> _pServer;
};

TEST_F(ServeTest, EveryRequestNeedsTheTokenAndTheLoopbackHost) {
  httplib::Client bare("127.0.0.1", _pServer->Port());
  EXPECT_EQ(bare.Get("/")->status, 403);
  EXPECT_EQ(bare.Get(("/?token=" + _pServer->Token() + "0").c_str())->status, 403);
  httplib::Result refused = bare.Post("/api/change", R"({"page":"grid","control":"checkSnap","value":"off"})",
                                      "application/json");
  EXPECT_EQ(refused->status, 403);
  // A page of another site that resolves its name to this machine: refused whatever it carries.
  for (const char* host : {"evil.example", "localhost", "127.0.0.1:1"}) {
    httplib::Result r = Client().Get("/api/stamp", {{"Host", host}});
    EXPECT_EQ(r->status, 403) << host;
  }
  EXPECT_FALSE(fs::exists(_user)); // nothing was changed by the refused requests

  httplib::Result page = bare.Get(("/?token=" + _pServer->Token()).c_str());
  ASSERT_EQ(page->status, 200);
  // The dialog render draws, its controls marked for the script, which the policy alone runs.
  EXPECT_TRUE(Has(page->body, "id=\"page-grid\""));
  EXPECT_TRUE(Has(page->body, "data-control=\"checkAllowDistortions\""));
  const std::string policy = page->get_header_value("Content-Security-Policy");
  const std::size_t nonce = policy.find("'nonce-");
  ASSERT_NE(nonce, std::string::npos) << policy;
  EXPECT_TRUE(Has(page->body, "<script nonce=\"" + policy.substr(nonce + 7, 32) + "\">"));
  // Only its own page and API: nothing else, and no way to the file system.
  EXPECT_EQ(Client().Get("/../../etc/passwd")->status, 404);
  EXPECT_EQ(Client().Get(("/" + _user.filename().string()).c_str())->status, 404);
  httplib::Result stamp = Client().Get("/api/stamp", {{"Accept-Encoding", "gzip, deflate, br"}});
  EXPECT_EQ(stamp->status, 200);
  EXPECT_EQ(stamp->get_header_value("Content-Encoding"), ""); // compressing costs more than it saves here
}

TEST_F(ServeTest, ChangeIsSavedAndTheWholeStateFollows) {
  const nlohmann::json before = State();
  EXPECT_FALSE(Control(before, "grid", "editorGridSpacingV")["enabled"]);
  EXPECT_TRUE(Has(Control(before, "grid", "editorGridSpacingV")["whyNot"].get<std::string>(), "checkAllowDistortions"));

  const nlohmann::json answer = Change("grid", "checkAllowDistortions", "on");
  EXPECT_TRUE(answer["ok"]) << answer["message"];
  EXPECT_EQ(Stored("DrwSketcherSpecific", "Drw_settings_AllowDistortions"), nlohmann::json({1, 0, 0, 0, 0}));
  const nlohmann::json& state = answer["state"];
  EXPECT_EQ(Control(state, "grid", "checkAllowDistortions")["shown"], "on");
  // The dependent controls are enabled at once, on the page and where another page shows them.
  for (const char* page : {"grid", "geometry"}) {
    EXPECT_TRUE(Control(state, page, "editorGridSpacingV")["enabled"]) << page;
    EXPECT_EQ(Control(state, page, "editorGridSpacingV")["whyNot"], "") << page;
  }
  EXPECT_TRUE(Has(Page(state, "grid")["html"].get<std::string>(), "class=\"check on\" data-name=\"checkAllowDistortions_dialog\""));

  // A value the control does not take: said, nothing written.
  const std::string saved = ReadBytes(_user);
  const nlohmann::json bad = Change("grid", "editorGridSpacing", "wide");
  EXPECT_FALSE(bad["ok"]);
  EXPECT_EQ(bad["code"], kExitBadValue);
  EXPECT_TRUE(Has(bad["message"].get<std::string>(), "not a number"));
  EXPECT_EQ(ReadBytes(_user), saved);

  // The scale range combo switches the range shown; a change then goes to that range.
  const nlohmann::json ranged = Change("grid", "cmbGridRange", "2");
  EXPECT_EQ(Page(ranged["state"], "grid")["range"], 2);
  EXPECT_EQ(Page(ranged["state"], "geometry")["range"], 1); // its own range combo
  EXPECT_TRUE(Change("grid", "editorGridSpacing", "25mm", {{"grid", 2}})["ok"]);
  EXPECT_EQ(Control(State({{"grid", 2}}), "grid", "editorGridSpacing")["shown"], "25 mm");
  EXPECT_EQ(Control(State({{"grid", 1}}), "grid", "editorGridSpacing")["shown"], "100 mm");
}

TEST_F(ServeTest, LockedControlIsRefusedWithWhoAndWhere) {
  WriteBytes(_admin, kSnapLocked);
  const nlohmann::json shown = Control(State(), "grid", "checkSnap");
  EXPECT_TRUE(shown["locked"]);
  EXPECT_FALSE(shown["enabled"]);

  const nlohmann::json answer = Change("grid", "checkSnap", "off");
  EXPECT_FALSE(answer["ok"]);
  EXPECT_EQ(answer["code"], kExitRefused);
  const std::string message = answer["message"];
  EXPECT_TRUE(Has(message, "cad-admin"));
  EXPECT_TRUE(Has(message, _admin.string()));
  EXPECT_EQ(Control(answer["state"], "grid", "checkSnap")["shown"], "on"); // back to the stored value
  EXPECT_FALSE(fs::exists(_user));

  // A faulty administrator's file stops every change, as it stops every command that writes.
  WriteBytes(_admin, "{\"format\": 1, \"settings\": ");
  const nlohmann::json faulty = Change("grid", "checkGrid", "off");
  EXPECT_EQ(faulty["code"], kExitFile);
  EXPECT_TRUE(Has(faulty["message"].get<std::string>(), _admin.string() + ":"));
  EXPECT_EQ(faulty["state"]["errors"].size(), 1u);
  EXPECT_FALSE(fs::exists(_user));
}

TEST_F(ServeTest, SubDialogControlsAreSetAsOnTheirPage) {
  const nlohmann::json answer = Change("geometry", "checkCstVisuSym", "off");
  EXPECT_TRUE(answer["ok"]) << answer["message"];
  EXPECT_EQ(Stored("DraftingOptions", "DrwGeoCstVisuSym"), 0);
  EXPECT_TRUE(Control(answer["state"], "geometry", "checkCstVisuSym")["inDialog"]);
  EXPECT_TRUE(Has(Page(answer["state"], "geometry")["html"].get<std::string>(), "id=\"dlg-geometry-"));

  // Without direct manipulation its dialog cannot be opened: its controls are refused with why.
  EXPECT_TRUE(Change("geometry", "checkGeomDrag", "off")["ok"]);
  const nlohmann::json refused = Change("geometry", "dragOptionPushButton", "open");
  EXPECT_EQ(refused["code"], kExitRefused);
  EXPECT_TRUE(Has(refused["message"].get<std::string>(), "checkGeomDrag"));
  // A dialog of the newer framework: opened, said, and closed again with its session.
  for (const char* button : {"pushLegendTableLayout", "pushTableSortCustomLists"}) {
    const nlohmann::json opened = Change("annotation", button, "open");
    EXPECT_TRUE(Has(opened["message"].get<std::string>(), "the dialog opened"));
  }
  EXPECT_TRUE(ZEPVidFraWindow::Windows().empty()); // the server is idle between requests

  const nlohmann::json hidden =
      Post("/api/change", R"({"page":"geometry","control":"checkDragWithEndPts","value":"off"})", 400);
  EXPECT_TRUE(Has(hidden.value("error", ""), "unknown control")); // its dialog is not open
}

// The PLM buttons offer what they take: the add button the repository's standards, the remove
// button the listed ones; a pick sends the standard's key.
TEST_F(ServeTest, PLMButtonsOfferTheirStandardsAndAPickSendsItsKey) {
  const nlohmann::json add = Control(State(), "main", "pusStandardPLMAdd");
  ASSERT_EQ(add["values"].size(), add["choices"].size());
  ASSERT_GE(add["values"].size(), 3u);
  EXPECT_TRUE(Control(State(), "main", "pusStandardPLMRemove")["values"].is_null()); // nothing listed yet
  const std::string key = add["values"][2]; // the second of two standards of the same name
  const nlohmann::json answer = Change("main", "pusStandardPLMAdd", key);
  ASSERT_TRUE(answer["ok"]) << answer["message"];
  EXPECT_EQ(Control(answer["state"], "main", "pusStandardPLMRemove")["values"], nlohmann::json::array({key}));
  const std::string choice = add["choices"][2];
  EXPECT_TRUE(Has(choice, key));
  EXPECT_EQ(Control(answer["state"], "main", "cmbStandardName")["shown"], choice.substr(0, choice.find("  (key")));
}

TEST_F(ServeTest, TwoClientsChangingAtOnceLoseNothing) {
  auto changes = [this](const char* iPage, const char* iControl, int iFrom) {
    for (int i = 0; i < 4; ++i)
      EXPECT_TRUE(Change(iPage, iControl, std::to_string(iFrom + i))["ok"]);
  };
  std::thread first(changes, "grid", "editorGridGraduation", 11);
  std::thread second(changes, "manipulators", "editorManipTransparency", 21);
  first.join();
  second.join();
  EXPECT_EQ(Stored("DrwSketcherSpecific", "Drw_settings_GridSecondaryStep")[0], 14);
  const nlohmann::json state = State();
  EXPECT_EQ(Control(state, "grid", "editorGridGraduation")["shown"], "14");
  EXPECT_EQ(Control(state, "manipulators", "editorManipTransparency")["shown"].get<std::string>().rfind("24", 0), 0u);
}

TEST_F(ServeTest, ChangesMadeElsewhereMoveTheStampAndShow) {
  auto stamp = [this] { return nlohmann::json::parse(Client().Get("/api/stamp")->body)["stamp"]; };
  const nlohmann::json first = stamp();
  ASSERT_EQ(RunBinary("set grid checkSnap off"), 0);
  const nlohmann::json second = stamp();
  EXPECT_NE(second, first);
  EXPECT_EQ(Control(State(), "grid", "checkSnap")["shown"], "off");
  ASSERT_EQ(RunBinary("lock grid checkGrid"), 0); // the administrator's new lock
  EXPECT_NE(stamp(), second);
  EXPECT_TRUE(Control(State(), "grid", "checkGrid")["locked"]);
}

TEST_F(ServeTest, MalformedAndOversizedBodiesAreRefused) {
  auto error = [](const nlohmann::json& j) { return j.value("error", std::string()); };
  EXPECT_TRUE(Has(error(Post("/api/change", "{\"page\": ", 400)), "not valid JSON"));
  EXPECT_TRUE(Has(error(Post("/api/change", "[1, 2]", 400)), "JSON object"));
  EXPECT_TRUE(Has(error(Post("/api/change", R"({"page":"grid","control":"checkSnap"})", 400)), "\"value\" is missing"));
  EXPECT_TRUE(Has(error(Post("/api/change", R"({"page":"grid","control":"checkSnap","value":{}})", 400)), "\"value\""));
  EXPECT_TRUE(Has(error(Post("/api/change", R"({"page":"gird","control":"checkSnap","value":"on"})", 400)), "grid"));
  EXPECT_TRUE(Has(error(Post("/api/state", R"({"ranges":{"grid":7}})", 400)), "1 to 5"));
  EXPECT_TRUE(Has(error(Post("/api/change", std::string(kServeMaxBody + 1, ' '), 413)), "KiB"));
  // Deep nesting within the bound: answered, and the server goes on.
  const std::string deep = std::string(30000, '[') + std::string(30000, ']');
  Post("/api/change", deep, 400);
  EXPECT_FALSE(fs::exists(_user));
  EXPECT_EQ(Change("grid", "checkSnap", "off")["ok"], true);
}

// The command: prints its address, serves, and ends with 0 on SIGTERM.
TEST_F(SettingsFolderTest, ServeCommandPrintsItsAddressAndStopsOnSigterm) {
  int out[2];
  ASSERT_EQ(pipe(out), 0);
  const pid_t pid = fork();
  ASSERT_GE(pid, 0);
  if (pid == 0) {
    dup2(out[1], STDOUT_FILENO);
    close(out[0]);
    execl(ZEP_APP_BINARY, ZEP_APP_BINARY, "serve", "--no-open", "--settings", _user.c_str(), "--admin",
          _admin.c_str(), static_cast<char*>(nullptr));
    _exit(127);
  }
  close(out[1]);
  // A failed assertion must not leave the server running.
  struct Reaper {
    pid_t pid;
    ~Reaper() {
      if (pid > 0 && waitpid(pid, nullptr, WNOHANG) == 0) {
        kill(pid, SIGKILL);
        waitpid(pid, nullptr, 0);
      }
    }
  } reaper{pid};
  // What the server printed, read until iUntil shows or the output ends.
  std::string printed;
  auto readUntil = [&](const char* iUntil) {
    char buffer[256];
    for (ssize_t n = 1; n > 0 && printed.find(iUntil) == std::string::npos;)
      if ((n = read(out[0], buffer, sizeof buffer)) > 0) printed.append(buffer, static_cast<std::size_t>(n));
  };
  readUntil("Ctrl+C");
  const std::size_t at = printed.find("http://127.0.0.1:");
  ASSERT_NE(at, std::string::npos) << printed;
  const int port = std::atoi(printed.c_str() + at + 17);
  const std::string token = printed.substr(printed.find("token=", at) + 6, 32);
  httplib::Client client("127.0.0.1", port);
  httplib::Result r = client.Post("/api/change", {{"X-Token", token}},
                                  R"({"page":"grid","control":"checkSnap","value":"off"})", "application/json");
  ASSERT_TRUE(r);
  EXPECT_EQ(r->status, 200);
  // Its port is its own: a second server cannot take it over, nor share it.
  const std::string files = " --settings " + ShellQuote(_user.string()) + " --admin " + ShellQuote(_admin.string());
  const std::string serve = "timeout 5 " + ShellQuote(ZEP_APP_BINARY) + " serve --no-open --port " +
                            std::to_string(port);
  EXPECT_EQ(RunShell(serve + files, _dir).code, 1);
  kill(pid, SIGTERM);
  int status = 0;
  ASSERT_EQ(waitpid(pid, &status, 0), pid);
  reaper.pid = 0;
  EXPECT_TRUE(WIFEXITED(status));
  EXPECT_EQ(WEXITSTATUS(status), 0);
  readUntil("Stopped.");
  close(out[0]);
  EXPECT_TRUE(Has(printed, "Stopped."));
  EXPECT_EQ(nlohmann::json::parse(ReadBytes(_user))["settings"]["DrwSketcherSpecific"]["Drw_settings_GridSnapPt"]["int"], 0);
}

} // namespace
