// The settings files: round trips, atomic saves under failure, and faulty files.
#include "SettingsFileSupport.h"
#include "ZEPAppSettingsFile.h"

#include <cerrno>
#include <climits>
#include <cmath>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <memory>
#include <random>
#include <set>

using namespace zepapp;
namespace fs = std::filesystem;

namespace {

std::set<std::string> Entries(const fs::path& iDir) {
  std::set<std::string> names;
  for (const auto& e : fs::directory_iterator(iDir)) names.insert(e.path().filename().string());
  return names;
}

// Line and column of an offset of ASCII text, counted by hand.
std::pair<int, int> Place(const std::string& iText, std::size_t iOffset) {
  const std::string before = iText.substr(0, iOffset);
  const std::size_t nl = before.rfind('\n');
  const int line = 1 + static_cast<int>(std::count(before.begin(), before.end(), '\n'));
  const int column = static_cast<int>(nl == std::string::npos ? iOffset + 1 : iOffset - nl);
  return {line, column};
}

// Sets an environment variable for the scope of a test and puts the old value back.
class ScopedEnv {
public:
  ScopedEnv(const char* iName, const char* iValue) : _name(iName) {
    if (const char* old = std::getenv(iName)) _old = old;
    Set(iValue);
  }
  ~ScopedEnv() { Set(_old ? _old->c_str() : nullptr); }

private:
  void Set(const char* iValue) { iValue ? setenv(_name, iValue, 1) : unsetenv(_name); }
  const char* _name;
  std::optional<std::string> _old;
};

// POSIX file operations that fail at one chosen step and count the files they create.
class FaultyOps : public ZEPAppPosixFileOps {
public:
  enum Step { None, CreateStep, WriteStep, FlushStep, SyncStep, CloseStep, RenameStep, SyncDirStep };
  Step failAt = None;
  int creates = 0;

  int Create(const std::string& p, int m, std::FILE*& f) override {
    ++creates;
    return failAt == CreateStep ? ENOSPC : ZEPAppPosixFileOps::Create(p, m, f);
  }
  int Write(std::FILE* f, const char* d, std::size_t n) override {
    if (failAt != WriteStep) return ZEPAppPosixFileOps::Write(f, d, n);
    ZEPAppPosixFileOps::Write(f, d, n / 2); // a disk that fills up half way
    return ENOSPC;
  }
  int Flush(std::FILE* f) override { return failAt == FlushStep ? EIO : ZEPAppPosixFileOps::Flush(f); }
  int Sync(std::FILE* f) override { return failAt == SyncStep ? EIO : ZEPAppPosixFileOps::Sync(f); }
  int Close(std::FILE* f) override {
    int err = ZEPAppPosixFileOps::Close(f);
    return failAt == CloseStep ? EIO : err;
  }
  int Rename(const std::string& a, const std::string& b) override {
    return failAt == RenameStep ? EXDEV : ZEPAppPosixFileOps::Rename(a, b);
  }
  int SyncDir(const std::string& d) override { return failAt == SyncDirStep ? EIO : ZEPAppPosixFileOps::SyncDir(d); }
};

using SettingsFileTest = SettingsFolderTest;

template <class T> std::vector<T> Read(ZEPSysSettingRepository* iRepo, const char* iName, int iCount) {
  std::vector<T> v(static_cast<std::size_t>(iCount));
  int n = iRepo ? iRepo->ReadAttr(iName, v.data(), iCount) : 0;
  v.resize(static_cast<std::size_t>(n));
  return v;
}

// A store that could not read iFile writes nothing to it: no save of the user's file; no lock,
// with or without a value, and no default in the administrator's. iFile still holds iText.
void ExpectNothingWritten(ZEPAppSettingsFile& ioStore, const fs::path& iFile, bool iAdmin, const std::string& iText) {
  const int v = 9;
  if (iAdmin) {
    EXPECT_LT(ioStore.Lock("DraftingOptions", "Unit"), 0);
    EXPECT_LT(ioStore.Lock("DraftingOptions", "Unit", std::vector<int>{v}), 0);
    EXPECT_LT(ioStore.SetAdminDefault("DraftingOptions", "Other", std::vector<int>{v}), 0);
  } else {
    ZEPSysSettingRepository* repo = ioStore.OpenSettings("DraftingOptions");
    repo->WriteAttr("Unit", &v, 1);
    EXPECT_LT(repo->SaveRepository(), 0);
    EXPECT_NE(std::string::npos, ioStore.LastError().find(iFile.string())) << ioStore.LastError();
  }
  EXPECT_EQ(iText, ReadBytes(iFile));
}

} // namespace

TEST_F(SettingsFileTest, RoundTripKeepsEveryKindWithDefaultsAndLocks) {
  ScopedEnv who("USER", "alice");
  WriteBytes(_admin, R"({"format": 1,
  "settings": {"DraftingOptions": {
    "DrwPaperLengthUnit": {"int": 2, "locked": true, "by": "cad-admin"},
    "Drw_GridSpacing": {"double": [5.0, 6.0]}}},
  "preferences": {"DraftingOptions": {"dlgPropTbBehaviorX": {"int": 7}}}})");
  // The user's file is reached through a link to a file that does not exist yet.
  fs::create_directory(_dir / "real");
  fs::create_symlink(_dir / "real" / "mine.json", _user);

  const std::vector<double> dbl = {0.1, -1e-300, 1.7976931348623157e308};
  const std::vector<int> ints = {INT_MIN, 0, INT_MAX};
  const std::vector<unsigned> uns = {0u, 255u, UINT_MAX};
  {
    ZEPAppSettingsFile store;
    ASSERT_EQ(S_OK, store.Load(_user.string(), _admin.string())) << store.LastError();
    ZEPSysSettingRepository* opts = store.OpenSettings("DraftingOptions");
    ZEPSysSettingRepository* sketch = store.OpenSettings("DrwSketcherGeneral");
    ZEPSysPreferenceRepository* prefs = store.OpenPreferences("DraftingOptions");
    const double one = -0.25;
    const int pref = 42;
    EXPECT_EQ(1, opts->WriteAttr("Dbl", dbl.data(), 3));
    EXPECT_EQ(1, opts->WriteAttr("One", &one, 1));
    EXPECT_EQ(1, opts->WriteAttr("Ints", ints.data(), 3));
    EXPECT_EQ(1, sketch->WriteAttr("Color", uns.data(), 3));
    EXPECT_EQ(1, prefs->WritePreference("dlgPropTbBehaviorY", &pref, 1));
    EXPECT_EQ(0, opts->WriteAttr("DrwPaperLengthUnit", &pref, 1));
    EXPECT_EQ(S_OK, opts->SaveRepository()) << store.LastError();
    EXPECT_EQ(S_OK, sketch->SaveRepository()) << store.LastError();
    EXPECT_EQ(S_OK, prefs->SaveRepository()) << store.LastError();
    // Locking without a value keeps the value the attribute shows now.
    EXPECT_EQ(S_OK, store.Lock("DrwSketcherGeneral", "Color")) << store.LastError();
    EXPECT_EQ(0, sketch->WriteAttr("Color", uns.data(), 1));
  }
  EXPECT_TRUE(fs::is_symlink(_user));
  EXPECT_TRUE(fs::is_regular_file(_dir / "real" / "mine.json"));

  ZEPSysSettingRepository::CloseAll();
  ZEPSysPreferenceRepository::CloseAll();
  {
    ZEPAppSettingsFile store;
    ASSERT_EQ(S_OK, store.Load(_user.string(), _admin.string())) << store.LastError();
    ZEPSysSettingRepository* opts = ZEPSysSettingRepository::GetRepository("DraftingOptions");
    ZEPSysSettingRepository* sketch = ZEPSysSettingRepository::GetRepository("DrwSketcherGeneral");
    ZEPSysPreferenceRepository* prefs = ZEPSysPreferenceRepository::GetPreferenceRepository("DraftingOptions");
    ASSERT_TRUE(opts && sketch && prefs);
    EXPECT_EQ(dbl, Read<double>(opts, "Dbl", 3));
    EXPECT_EQ(std::vector<double>{-0.25}, Read<double>(opts, "One", 1));
    EXPECT_EQ(ints, Read<int>(opts, "Ints", 3));
    EXPECT_EQ(uns, Read<unsigned>(sketch, "Color", 3));
    EXPECT_EQ(std::vector<int>{42}, Read<int>(prefs, "dlgPropTbBehaviorY", 1));
    EXPECT_EQ(std::vector<int>{7}, Read<int>(prefs, "dlgPropTbBehaviorX", 1));
    EXPECT_TRUE(Read<int>(opts, "Dbl", 3).empty()) << "a double attribute read as int";

    // The administrator's lock holds and says who and where.
    const int three = 3;
    EXPECT_EQ(std::vector<int>{2}, Read<int>(opts, "DrwPaperLengthUnit", 1));
    EXPECT_EQ(0, opts->WriteAttr("DrwPaperLengthUnit", &three, 1));
    ZEPSettingInfo info;
    opts->GetLockInfo("DrwPaperLengthUnit", info);
    EXPECT_TRUE(info.IsLocked());
    EXPECT_EQ("Locked by cad-admin in " + _admin.string(), info.GetLockText());
    sketch->GetLockInfo("Color", info);
    EXPECT_EQ("Locked by alice in " + _admin.string(), info.GetLockText());
    EXPECT_LT(store.Reset("DraftingOptions", "DrwPaperLengthUnit"), 0);
    EXPECT_NE(std::string::npos, store.LastError().find("cad-admin"));

    // A default is not a lock.
    EXPECT_EQ((std::vector<double>{5.0, 6.0}), Read<double>(opts, "Drw_GridSpacing", 2));
    const double seven = 7.5;
    EXPECT_EQ(1, opts->WriteAttr("Drw_GridSpacing", &seven, 1));

    EXPECT_EQ(S_OK, store.Unlock("DrwSketcherGeneral", "Color")) << store.LastError();
    EXPECT_EQ(1, store.Unlock("DrwSketcherGeneral", "Color"));
    EXPECT_EQ(S_OK, store.Reset("DraftingOptions", "Dbl")) << store.LastError();
    EXPECT_TRUE(Read<double>(opts, "Dbl", 3).empty());
    EXPECT_EQ(S_OK, store.SaveAll()) << store.LastError();
  }

  ZEPSysSettingRepository::CloseAll();
  ZEPSysPreferenceRepository::CloseAll();
  ZEPAppSettingsFile store;
  ASSERT_EQ(S_OK, store.Load(_user.string(), _admin.string())) << store.LastError();
  ZEPSysSettingRepository* opts = store.OpenSettings("DraftingOptions");
  ZEPSysSettingRepository* sketch = store.OpenSettings("DrwSketcherGeneral");
  EXPECT_FALSE(sketch->IsLocked("Color"));
  EXPECT_EQ(1, sketch->WriteAttr("Color", uns.data(), 1)) << "unlocked";
  EXPECT_FALSE(opts->HasUserValue("Dbl"));
  EXPECT_EQ(std::vector<double>{7.5}, Read<double>(opts, "Drw_GridSpacing", 2));

  // Resetting everything brings the administrator's defaults back and keeps the locked values.
  EXPECT_EQ(S_OK, store.ResetAll()) << store.LastError();
  EXPECT_EQ((std::vector<double>{5.0, 6.0}), Read<double>(opts, "Drw_GridSpacing", 2));
  EXPECT_TRUE(Read<int>(opts, "Ints", 3).empty());
  EXPECT_TRUE(Read<int>(store.OpenPreferences("DraftingOptions"), "dlgPropTbBehaviorY", 1).empty());
  EXPECT_EQ(std::vector<int>{2}, Read<int>(opts, "DrwPaperLengthUnit", 1));
}

TEST_F(SettingsFileTest, TextsRoundTripLockAndKeepTheirKind) {
  ScopedEnv who("USER", "alice");
  WriteBytes(_admin, "{\"settings\": {\"DraftingOptions\": {\n"
                     "  \"DrwStandard\": {\"text\": \"ISO\", \"locked\": true, \"by\": \"cad-admin\"},\n"
                     "  \"DrwFolders\": {\"text\": []}}}}");
  const std::vector<std::string> one = {"Folder"}, none = {},
                                 awkward = {"Dr\xC3\xA4wings \xE6\x97\xA5", "say \"hi\"", "C:\\temp", "tab\tnl\n\x01\x1f", ""};
  std::vector<std::string> read;
  {
    ZEPAppSettingsFile store;
    ASSERT_EQ(S_OK, store.Load(_user.string(), _admin.string())) << store.LastError();
    ZEPSysSettingRepository* opts = store.OpenSettings("DraftingOptions");
    EXPECT_EQ(1, opts->ReadAttr("DrwStandard", read));
    EXPECT_EQ(std::vector<std::string>{"ISO"}, read);
    EXPECT_EQ(0, opts->WriteAttr("DrwStandard", one)) << "locked";
    EXPECT_EQ(0, opts->ReadAttr("DrwFolders", read)) << "an empty list is a value";
    EXPECT_EQ(1, opts->WriteAttr("One", one));
    EXPECT_EQ(1, opts->WriteAttr("Awkward", awkward));
    EXPECT_EQ(1, opts->WriteAttr("DrwFolders", none));
    ASSERT_EQ(S_OK, opts->SaveRepository()) << store.LastError();
    // A text is written as a scalar, as a single number is.
    EXPECT_NE(std::string::npos, ReadBytes(_user).find("\"One\": {\n        \"text\": \"Folder\"\n")) << ReadBytes(_user);
    EXPECT_NE(std::string::npos, ReadBytes(_user).find("\"text\": []")) << ReadBytes(_user);
    // Locking at a text, and at the text an attribute shows.
    EXPECT_EQ(S_OK, store.Lock("DraftingOptions", "Locked", std::vector<std::string>{"a", "b"})) << store.LastError();
    EXPECT_EQ(S_OK, store.Lock("DraftingOptions", "Awkward")) << store.LastError();
    EXPECT_EQ(0, opts->WriteAttr("Locked", one));
    // What no file can hold is refused before anything is written.
    const std::string admin = ReadBytes(_admin);
    EXPECT_LT(store.SetAdminDefault("DraftingOptions", "Bad", std::vector<std::string>{"ok", "\xC3"}), 0);
    EXPECT_NE(std::string::npos, store.LastError().find("text 2 is not valid UTF-8")) << store.LastError();
    EXPECT_LT(store.Lock("DraftingOptions", "Bad", std::vector<std::string>{std::string("a\0b", 3)}), 0);
    EXPECT_EQ(admin, ReadBytes(_admin));
    const std::string user = ReadBytes(_user);
    opts->SetUserValue("One", std::vector<std::string>{"\xFF"});
    opts->WriteAttr("Other", one);
    EXPECT_LT(opts->SaveRepository(), 0);
    EXPECT_NE(std::string::npos, store.LastError().find("One cannot be saved: text 1")) << store.LastError();
    EXPECT_EQ(user, ReadBytes(_user));
  }

  ZEPSysSettingRepository::CloseAll();
  ZEPAppSettingsFile store;
  ASSERT_EQ(S_OK, store.Load(_user.string(), _admin.string())) << store.LastError();
  ZEPSysSettingRepository* opts = store.OpenSettings("DraftingOptions");
  EXPECT_EQ(1, opts->ReadAttr("One", read));
  EXPECT_EQ(one, read);
  EXPECT_EQ(5, opts->ReadAttr("Awkward", read));
  EXPECT_EQ(awkward, read);
  EXPECT_TRUE(opts->IsLocked("Awkward"));
  EXPECT_EQ(0, opts->ReadAttr("DrwFolders", read));
  EXPECT_EQ(2, opts->ReadAttr("Locked", read));
  EXPECT_EQ((std::vector<std::string>{"a", "b"}), read);
  EXPECT_EQ("alice", store.AdminDoc().settings.at("DraftingOptions").at("Locked").by);

  // A text where a number is expected, and the reverse, is a value of the wrong kind; a list
  // of texts takes any number of them.
  std::vector<ZEPAppAttrRule> rules(3);
  rules[0] = {ZEPAppRepoKind::Setting, "DraftingOptions", "Len", 0, 1, {}};
  rules[1] = {ZEPAppRepoKind::Setting, "DraftingOptions", "Std", 3, kAnyCount, {}};
  rules[2] = {ZEPAppRepoKind::Setting, "DraftingOptions", "Stds", 3, kAnyCount, {}};
  WriteBytes(_user, "{\"settings\": {\"DraftingOptions\": {\n"
                    "  \"Len\": {\"text\": \"5\"},\n"
                    "  \"Std\": {\"double\": 5},\n"
                    "  \"Stds\": {\"text\": [\"ISO\", \"ANSI\", \"JIS\"]}}}}");
  ZEPSysSettingRepository::CloseAll();
  ZEPAppSettingsFile checked;
  checked.SetRules(rules);
  ASSERT_EQ(S_OK, checked.Load(_user.string(), (_dir / "other_admin.json").string()));
  ASSERT_EQ(2u, checked.LoadWarnings().size());
  EXPECT_EQ(_user.string() + ":2:19: settings/DraftingOptions/Len: holds \"text\" values, expected \"double\"; "
                             "the default is used instead",
            checked.LoadWarnings()[0].Text());
  EXPECT_EQ(_user.string() + ":3:21: settings/DraftingOptions/Std: holds \"double\" values, expected \"text\"; "
                             "the default is used instead",
            checked.LoadWarnings()[1].Text());
  opts = checked.OpenSettings("DraftingOptions");
  EXPECT_FALSE(opts->HasUserValue("Len"));
  EXPECT_EQ(3, opts->ReadAttr("Stds", read));
  EXPECT_LT(checked.SetAdminDefault("DraftingOptions", "Len", std::vector<std::string>{"5"}), 0);
  EXPECT_NE(std::string::npos, checked.LastError().find("expected \"double\"")) << checked.LastError();
}

TEST_F(SettingsFileTest, SavesKeepWhatAnotherProcessWroteSinceTheLoad) {
  auto stored = [&](const char* iAttr) -> std::optional<int> {
    ZEPAppSettingsDoc doc;
    if (!ParseSettingsText(ReadBytes(_user), "", false, doc).empty()) return -1;
    const auto& entries = doc.settings["R"];
    auto it = entries.find(iAttr);
    if (it == entries.end()) return std::nullopt;
    const auto* ints = std::get_if<std::vector<int>>(&*it->second.value);
    return ints ? ints->at(0) : -2;
  };
  const std::string other = "{\"settings\": {\"R\": {\"A\": {\"int\": 2}, \"C\": {\"int\": 1}, "
                            "\"E\": {\"int\": 5}, \"W\": {\"double\": 1}}}}";
  // Loaded from a file, or from none; either way another process writes before each save.
  for (bool fileAtLoad : {true, false}) {
    SCOPED_TRACE(fileAtLoad ? "a file at load" : "no file at load");
    fs::remove(_user);
    if (fileAtLoad)
      WriteBytes(_user, "{\"settings\": {\"R\": {\"A\": {\"int\": 1}, \"C\": {\"int\": 1}, "
                        "\"W\": {\"double\": 1}}}}");
    ZEPSysSettingRepository::CloseAll();
    ZEPAppSettingsFile store;
    std::vector<ZEPAppAttrRule> rules(5);
    for (std::size_t k = 0; k < rules.size(); ++k)
      rules[k] = {ZEPAppRepoKind::Setting, "R", std::string(1, "ABCEW"[k]), 1, 1, {}};
    store.SetRules(rules); // W holds a double where an int is expected: reported, never applied
    ASSERT_EQ(S_OK, store.Load(_user.string()));
    ZEPSysSettingRepository* repo = store.OpenSettings("R");
    WriteBytes(_user, other);
    const int three = 3, four = 4, six = 6;
    repo->WriteAttr("B", &three, 1);
    if (fileAtLoad) store.Reset("R", "C");
    ASSERT_EQ(S_OK, repo->SaveRepository()) << store.LastError();
    EXPECT_EQ(2, stored("A")) << "changed by the other process, not by this one";
    EXPECT_EQ(3, stored("B"));
    EXPECT_EQ(fileAtLoad ? std::nullopt : std::optional<int>(1), stored("C"));
    EXPECT_EQ(5, stored("E"));
    EXPECT_EQ(-2, stored("W")) << "the double left out stays as it was";
    // Again after this run's own save, and once more after another rewrite.
    repo->WriteAttr("B", &four, 1);
    ASSERT_EQ(S_OK, repo->SaveRepository()) << store.LastError();
    EXPECT_EQ(2, stored("A"));
    WriteBytes(_user, std::string(ReadBytes(_user)).replace(ReadBytes(_user).find("\"int\": 2"), 8, "\"int\": 7"));
    repo->WriteAttr("W", &six, 1); // the value left out is replaced once this run sets it ...
    ASSERT_EQ(S_OK, repo->SaveRepository()) << store.LastError();
    EXPECT_EQ(7, stored("A"));
    EXPECT_EQ(4, stored("B"));
    EXPECT_EQ(6, stored("W"));
    EXPECT_EQ(S_OK, store.Reset("R", "W")); // ... and then reset like any other
    EXPECT_EQ(std::nullopt, stored("W"));
    EXPECT_EQ(7, stored("A"));
  }

  // A repository the other process added, opened after a save that failed, gets its values.
  auto ops = std::make_shared<FaultyOps>();
  WriteBytes(_user, "{\"settings\": {\"R\": {\"A\": {\"int\": 1}}}}");
  ZEPSysSettingRepository::CloseAll();
  ZEPAppSettingsFile store(ops);
  ASSERT_EQ(S_OK, store.Load(_user.string()));
  ZEPSysSettingRepository* repo = store.OpenSettings("R");
  WriteBytes(_user, "{\"settings\": {\"R\": {\"A\": {\"int\": 1}}, \"S\": {\"X\": {\"int\": 9}}}}");
  const int two = 2;
  repo->WriteAttr("A", &two, 1);
  ops->failAt = FaultyOps::RenameStep;
  EXPECT_LT(repo->SaveRepository(), 0);
  ops->failAt = FaultyOps::None;
  EXPECT_EQ(std::vector<int>{9}, Read<int>(store.OpenSettings("S"), "X", 1));
  ASSERT_EQ(S_OK, repo->SaveRepository()) << store.LastError();
  EXPECT_NE(std::string::npos, ReadBytes(_user).find("\"X\"")) << ReadBytes(_user);
}

TEST_F(SettingsFileTest, FailedSaveLeavesTheOldFileAndNoTemporaryFile) {
  auto ops = std::make_shared<FaultyOps>();
  ZEPAppSettingsFile store(ops);
  ASSERT_EQ(S_OK, store.Load(_user.string()));
  ZEPSysSettingRepository* repo = store.OpenSettings("DraftingOptions");
  int value = 1;
  repo->WriteAttr("DrwPaperLengthUnit", &value, 1);
  ASSERT_EQ(S_OK, repo->SaveRepository()) << store.LastError();
  const std::string old = ReadBytes(_user);
  const std::set<std::string> onlyTheFile = {"settings.json", "settings.json.lock"};

  for (auto step : {FaultyOps::CreateStep, FaultyOps::WriteStep, FaultyOps::FlushStep, FaultyOps::SyncStep,
                    FaultyOps::CloseStep, FaultyOps::RenameStep}) {
    SCOPED_TRACE(step);
    ops->failAt = step;
    value = 100 + step;
    ASSERT_EQ(1, repo->WriteAttr("DrwPaperLengthUnit", &value, 1));
    EXPECT_LT(repo->SaveRepository(), 0);
    EXPECT_NE(std::string::npos, store.LastError().find(_user.string())) << store.LastError();
    EXPECT_EQ(old, ReadBytes(_user));
    EXPECT_EQ(onlyTheFile, Entries(_dir));
  }

  // A failed save keeps the change pending: the next save writes it.
  ops->failAt = FaultyOps::None;
  EXPECT_EQ(S_OK, repo->SaveRepository()) << store.LastError();
  EXPECT_NE(old, ReadBytes(_user));

  // Syncing the folder comes after the rename: the file is new, but the save is not durable.
  ops->failAt = FaultyOps::SyncDirStep;
  value = 500;
  repo->WriteAttr("DrwPaperLengthUnit", &value, 1);
  EXPECT_LT(repo->SaveRepository(), 0);
  EXPECT_NE(std::string::npos, store.LastError().find("sync")) << store.LastError();
  EXPECT_EQ(onlyTheFile, Entries(_dir));

  ops->failAt = FaultyOps::None;
  ZEPSysSettingRepository::CloseAll();
  ZEPAppSettingsFile reread;
  ASSERT_EQ(S_OK, reread.Load(_user.string()));
  EXPECT_EQ(std::vector<int>{500}, Read<int>(reread.OpenSettings("DraftingOptions"), "DrwPaperLengthUnit", 1));

  // A failed save leaves nothing of itself behind: changed back, the value is not written later.
  auto failing = std::make_shared<FaultyOps>();
  failing->failAt = FaultyOps::RenameStep;
  ZEPSysSettingRepository::CloseAll();
  ZEPAppSettingsFile store2(failing);
  ASSERT_EQ(S_OK, store2.Load(_user.string()));
  ZEPSysSettingRepository* again = store2.OpenSettings("DraftingOptions");
  for (int v : {7, 500}) {
    again->WriteAttr("DrwPaperLengthUnit", &v, 1);
    again->WriteAttr("New", &v, 1);
    EXPECT_LT(again->SaveRepository(), 0);
  }
  again->ResetAttr("New");
  failing->failAt = FaultyOps::None;
  const int other = 3;
  again->WriteAttr("Other", &other, 1);
  ASSERT_EQ(S_OK, again->SaveRepository()) << store2.LastError();
  ZEPSysSettingRepository::CloseAll();
  ZEPAppSettingsFile last;
  ASSERT_EQ(S_OK, last.Load(_user.string()));
  ZEPSysSettingRepository* saved = last.OpenSettings("DraftingOptions");
  EXPECT_EQ(std::vector<int>{500}, Read<int>(saved, "DrwPaperLengthUnit", 1));
  EXPECT_EQ(std::vector<int>{3}, Read<int>(saved, "Other", 1));
  EXPECT_FALSE(saved->HasUserValue("New"));
}

TEST_F(SettingsFileTest, SaveWithNothingChangedWritesNothing) {
  auto ops = std::make_shared<FaultyOps>();
  {
    ZEPAppSettingsFile store(ops);
    ASSERT_EQ(S_OK, store.Load(_user.string()));
    ZEPSysSettingRepository* repo = store.OpenSettings("DraftingOptions");
    EXPECT_EQ(S_OK, store.SaveAll());
    EXPECT_EQ(0, ops->creates);
    EXPECT_FALSE(fs::exists(_user)) << "nothing to save creates no file";

    const double spacing[2] = {10.0, 20.0}, other = 3.0;
    repo->WriteAttr("Spacing", spacing, 2);
    EXPECT_EQ(S_OK, repo->SaveRepository());
    EXPECT_EQ(1, ops->creates);
    EXPECT_EQ(S_OK, repo->SaveRepository());
    repo->WriteAttr("Spacing", spacing, 2); // same value again
    EXPECT_EQ(S_OK, repo->SaveRepository());
    repo->WriteAttr("Spacing", &other, 1); // changed, then changed back before saving
    repo->WriteAttr("Spacing", spacing, 2);
    EXPECT_EQ(S_OK, repo->SaveRepository());
    EXPECT_EQ(1, ops->creates);
  }
  ZEPSysSettingRepository::CloseAll();
  const auto stamp = fs::last_write_time(_user);
  ZEPAppSettingsFile store(ops);
  ASSERT_EQ(S_OK, store.Load(_user.string()));
  store.OpenSettings("DrwSketcherGeneral");
  EXPECT_EQ(S_OK, store.SaveAll());
  EXPECT_EQ(S_OK, store.ResetAll("DrwSketcherGeneral"));
  EXPECT_EQ(1, ops->creates);
  EXPECT_EQ(stamp, fs::last_write_time(_user));
}

TEST_F(SettingsFileTest, TruncatedFileIsReportedWhereItEndsAndNeverOverwritten) {
  const std::string userSample = "{\n  \"format\": 1,\n  \"settings\": {\n    \"DraftingOptions\": {\n"
                                 "      \"Spacing\": {\"double\": [10.5, -0.25e2]},\n"
                                 "      \"Unit\": {\"int\": -3}\n    }\n  },\n"
                                 "  \"preferences\": {\"DraftingOptions\": {\"X\": {\"unsigned\": [7]}}}\n}\n";
  const std::string adminSample = "{\"settings\": {\"DraftingOptions\": {\n"
                                  "  \"Unit\": {\"int\": 2, \"locked\": true, \"by\": \"root\"},\n"
                                  "  \"Flag\": {\"locked\": false, \"unsigned\": 1}}}}\n";
  for (bool admin : {false, true}) {
    const std::string& sample = admin ? adminSample : userSample;
    const fs::path file = admin ? _admin : _user;
    for (std::size_t len = 0; len < sample.size(); ++len) {
      SCOPED_TRACE((admin ? "admin, " : "user, ") + std::to_string(len) + " bytes");
      const std::string prefix = sample.substr(0, len);
      WriteBytes(file, prefix);
      ZEPSysSettingRepository::CloseAll();
      ZEPAppSettingsFile store;
      const long rc = admin ? store.Load((_dir / "none.json").string(), file.string()) : store.Load(file.string());
      if (len == 0 || len + 1 == sample.size()) { // blank, or all but the final newline
        EXPECT_EQ(S_OK, rc) << store.LastError();
        continue;
      }
      ASSERT_EQ(E_FAIL, rc);
      ASSERT_FALSE(store.LoadErrors().empty());
      const ZEPAppFileError& e = store.LoadErrors().front();
      EXPECT_EQ(file.string(), e.path);
      EXPECT_EQ(Place(prefix, len), std::make_pair(e.line, e.column)) << e.Text();
      ExpectNothingWritten(store, file, admin, prefix);
    }
  }
}

TEST_F(SettingsFileTest, WrongTypesAreReportedAtTheValue) {
  struct Case {
    bool admin;
    std::string text; // "@@" marks where the fault must be reported
    std::string says;
  };
  const std::string head = "{\"format\": 1,\n \"settings\": {\"DraftingOptions\": {\n  ";
  const std::vector<Case> cases = {
      {false, head + "\"Unit\": {\"int\": @@\"one\"}}}}", "expected an integer"},
      {false, head + "\"Unit\": {\"int\": [1, @@1.5]}}}}", "found 1.5"},
      {false, head + "\"Color\": {\"unsigned\": [255, @@-1]}}}}", "expected an unsigned"},
      {false, head + "\"Color\": {\"unsigned\": @@4294967296}}}}", "expected an unsigned"},
      {false, head + "\"Unit\": {\"int\": [0,\n @@2147483648]}}}}", "expected an integer"},
      {false, head + "\"Len\": {\"double\": [1, @@1e999]}}}}", "too large"},
      {false, head + "\"Len\": {\"double\": [1, @@null]}}}}", "finite number"},
      {false, head + "\"Len\": {\"double\": 2.0, @@\"int\": 2}}}}", "more than one"},
      {false, head + "\"Std\": {\"int\": 2,\n @@\"text\": \"ISO\"}}}}",
       "more than one of \"double\", \"int\", \"unsigned\" and \"text\""},
      {false, head + "\"Std\": {\"text\": [\"ISO\", @@2]}}}}", "text[1]: expected a text, found 2"},
      {false, head + "\"Std\": {\"text\": @@{}}}}}", "text: expected a text, found an object"},
      {false, head + "\"Std\": {\"text\": [\"a\", @@\"b\\u0000\"]}}}}", "\\u0000"},
      {false, head + "\"Std\": {\"text\": \"a\", @@\"txt\": 1}}}}",
       "expected \"double\", \"int\", \"unsigned\" or \"text\""},
      {true, head + "\"Std\": @@{\"by\": \"x\"}}}}", "no value: expected \"double\", \"int\", \"unsigned\" or \"text\""},
      {false, head + "\"Len\": @@4}}}", "expected an object"},
      {false, head + "\"Len\": @@{}}}}", "no value"},
      {false, head + "\"Unit\": {\"int\": 1, @@\"locked\": true}}}}", "administrator's file"},
      {false, head + "\"Unit\": {\"int\": 1},\n  @@\"Unit\": {\"int\": 2}}}}", "appears twice"},
      {false, "{@@\"setings\": {}}", "unknown key"},
      {false, "{\"format\": @@2}", "unsupported format"},
      {false, "{\"settings\": {\"DraftingOptions\": @@[1, 2]}}", "object of attributes"},
      {false, "@@[1, 2]", "expected an object"},
      {true, head + "\"Unit\": {\"int\": 1, \"locked\": @@\"yes\"}}}}", "true or false"},
      {true, head + "\"Unit\": {\"int\": 1, @@\"lock\": true}}}}", "unknown key"},
  };
  WriteBytes(_dir / "good_admin.json", "{\"settings\": {\"DraftingOptions\": {\"Kept\": {\"int\": 4, \"locked\": true}}}}");
  for (const Case& c : cases) {
    SCOPED_TRACE(c.text);
    const std::size_t at = c.text.find("@@");
    const std::string text = c.text.substr(0, at) + c.text.substr(at + 2);
    const fs::path file = c.admin ? _admin : _user;
    WriteBytes(file, text);
    ZEPSysSettingRepository::CloseAll();
    ZEPAppSettingsFile store;
    const std::string other = (_dir / (c.admin ? "missing.json" : "good_admin.json")).string();
    ASSERT_EQ(E_FAIL, c.admin ? store.Load(other, file.string()) : store.Load(file.string(), other));
    ASSERT_EQ(1u, store.LoadErrors().size()) << store.LastError();
    const ZEPAppFileError& e = store.LoadErrors().front();
    EXPECT_EQ(Place(text, at), std::make_pair(e.line, e.column)) << e.Text();
    EXPECT_NE(std::string::npos, e.message.find(c.says)) << e.Text();

    EXPECT_TRUE(c.admin || store.OpenSettings("DraftingOptions")->IsLocked("Kept")) << "the other file applies";
    ExpectNothingWritten(store, file, c.admin, text);
  }
}

TEST_F(SettingsFileTest, InvalidUtf8IsReportedAtTheByte) {
  // Line 3 holds four spaces, a quote, "M", "a" and "ß" before the bad byte: column 9 in a
  // name, column 25 in a text.
  for (const std::string bad : {"\xFF", "\xC0\xAF", "\xED\xA0\x80", "\xE2\x82", "\xF4\x90\x80\x80"})
    for (bool inText : {false, true}) {
      const std::string text = "{\"settings\": {\n  \"DraftingOptions\": {\n    \"" +
                               (inText ? "Std\": {\"text\": \"Ma\xC3\x9F" + bad + "\"}}}}\n"
                                       : "Ma\xC3\x9F" + bad + "\": {\"int\": 1}}}}\n");
      WriteBytes(_user, text);
      ZEPSysSettingRepository::CloseAll();
      ZEPAppSettingsFile store;
      ASSERT_EQ(E_FAIL, store.Load(_user.string()));
      const ZEPAppFileError& e = store.LoadErrors().front();
      EXPECT_EQ(std::make_pair(3, inText ? 25 : 9), std::make_pair(e.line, e.column)) << e.Text();
      EXPECT_NE(std::string::npos, e.message.find("UTF-8"));
      ExpectNothingWritten(store, _user, false, text);
    }
}

TEST_F(SettingsFileTest, AnyInputIsReportedNeverACrash) {
  const std::string sample = "{\"format\": 1, \"settings\": {\"DraftingOptions\": {\"Unit\": {\"int\": [1, 2]},\n"
                             "\"Len\": {\"double\": 2.5e-3}, \"Col\": {\"unsigned\": 255, \"locked\": true}}},\n"
                             "\"preferences\": {\"P\": {\"X\": {\"int\": -4}}}}";
  std::mt19937 random(20240607u);
  const char alphabet[] = "{}[]\",:0-.e1\\u tfn\x80\xC3\xFF";
  for (int round = 0; round < 400; ++round) {
    const std::string text = Garbled(sample, random, alphabet, 3);
    WriteBytes(_admin, text);
    ZEPSysSettingRepository::CloseAll();
    ZEPSysPreferenceRepository::CloseAll();
    ZEPAppSettingsFile store;
    if (store.Load((_dir / "none.json").string(), _admin.string()) == S_OK) continue;
    ASSERT_FALSE(store.LoadErrors().empty()) << text;
    for (const ZEPAppFileError& e : store.LoadErrors()) {
      EXPECT_GE(e.line, 1) << text;
      EXPECT_LE(e.line, 3) << text;
      EXPECT_GE(e.column, 1) << text;
    }
  }

  // Deep nesting, a folder in place of the file, and values that no file may hold.
  WriteBytes(_user, "{\"settings\": " + std::string(100000, '[') + std::string(100000, ']') + "}");
  ZEPAppSettingsFile deep;
  EXPECT_EQ(E_FAIL, deep.Load(_user.string()));
  fs::remove(_user);
  fs::create_directory(_user);
  ZEPAppSettingsFile folder;
  EXPECT_EQ(E_FAIL, folder.Load(_user.string()));
  EXPECT_NE(std::string::npos, folder.LastError().find(_user.string()));
  fs::remove(_user);

  ZEPSysSettingRepository::CloseAll();
  ZEPAppSettingsFile store;
  ASSERT_EQ(S_OK, store.Load(_user.string(), _admin.string() + ".new"));
  ZEPSysSettingRepository* repo = store.OpenSettings("DraftingOptions");
  const double ok = 1.0;
  repo->WriteAttr("Len", &ok, 1);
  ASSERT_EQ(S_OK, repo->SaveRepository());
  const std::string saved = ReadBytes(_user);
  repo->SetUserValue("Len", std::vector<double>{1.0, std::nan("")});
  repo->WriteAttr("Other", &ok, 1);
  EXPECT_LT(repo->SaveRepository(), 0);
  EXPECT_NE(std::string::npos, store.LastError().find("Len")) << store.LastError();
  EXPECT_EQ(saved, ReadBytes(_user));
  EXPECT_LT(store.Lock("DraftingOptions", "Len", std::vector<double>{HUGE_VAL}), 0);
  EXPECT_LT(store.SetAdminDefault("DraftingOptions", "Len", std::vector<double>{-HUGE_VAL}), 0);
  EXPECT_FALSE(fs::exists(_admin.string() + ".new"));
}

TEST_F(SettingsFileTest, DefaultLocationsFollowOptionsThenEnvironment) {
  ScopedEnv home("HOME", "/home/bob");
  ScopedEnv xdg("XDG_CONFIG_HOME", nullptr);
  ScopedEnv userEnv(kSettingsFileEnv, nullptr);
  ScopedEnv adminEnv(kAdminFileEnv, nullptr);
  ScopedEnv systemDirs("XDG_CONFIG_DIRS", nullptr);
  ZEPAppSettingsPaths p = ResolveSettingsPaths();
  EXPECT_EQ("/home/bob/.config/drafting-options/settings.json", p.user);
  EXPECT_EQ("/etc/xdg/drafting-options/admin.json", p.admin) << "locks apply without any environment";
  {
    // The first folder that holds the file wins; relative folders do not count.
    const fs::path dir = fs::temp_directory_path() / ("zep_xdg_" + std::to_string(::getpid()));
    fs::create_directories(dir / "b" / "drafting-options");
    WriteBytes(dir / "b" / "drafting-options" / "admin.json", "{}");
    const std::string dirs = "rel:" + (dir / "a").string() + ":" + (dir / "b").string();
    ScopedEnv x("XDG_CONFIG_DIRS", dirs.c_str());
    EXPECT_EQ((dir / "b" / "drafting-options" / "admin.json").string(), ResolveSettingsPaths().admin);
    EXPECT_EQ((dir / "b" / "drafting-options" / "admin.json").string(), ResolveSettingsPaths("", "").admin)
        << "an empty option does not drop the locks";
    fs::remove_all(dir / "b");
    EXPECT_EQ((dir / "a" / "drafting-options" / "admin.json").string(), ResolveSettingsPaths().admin);
    fs::remove_all(dir);
  }
  {
    ScopedEnv x("XDG_CONFIG_HOME", "/cfg");
    EXPECT_EQ("/cfg/drafting-options/settings.json", ResolveSettingsPaths().user);
    ScopedEnv relative("XDG_CONFIG_HOME", "relative/cfg");
    EXPECT_EQ(p.user, ResolveSettingsPaths().user);
  }
  ScopedEnv u(kSettingsFileEnv, "/tmp/s.json");
  ScopedEnv a(kAdminFileEnv, "/etc/a.json");
  p = ResolveSettingsPaths();
  EXPECT_EQ("/tmp/s.json", p.user);
  EXPECT_EQ("/etc/a.json", p.admin);
  p = ResolveSettingsPaths("mine.json", "theirs.json");
  EXPECT_EQ("mine.json", p.user);
  EXPECT_EQ("theirs.json", p.admin);
}
