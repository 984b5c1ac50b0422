// Helpers of the settings file tests: file contents, a temporary folder per test, and runs of
// the command line in this process or as the binary.
#pragma once

#include "TestSupport.h"
#include "ZEPAppCli.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <sstream>
#include <string>
#include <vector>

#include <sys/wait.h>

inline std::string ReadBytes(const std::filesystem::path& iPath) {
  std::ifstream in(iPath, std::ios::binary);
  return std::string(std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>());
}

// A fresh file each time: truncating one in place makes some file systems flush it at once.
inline void WriteBytes(const std::filesystem::path& iPath, const std::string& iText) {
  std::error_code ec;
  std::filesystem::remove(iPath, ec);
  std::ofstream(iPath, std::ios::binary) << iText;
}

// A host reset around each test, and a temporary folder holding settings.json and admin.json.
class SettingsFolderTest : public ZEPHostTest {
protected:
  void SetUp() override {
    ZEPHostTest::SetUp();
    std::string pattern = (std::filesystem::temp_directory_path() / "zep_settings_XXXXXX").string();
    ASSERT_NE(nullptr, mkdtemp(pattern.data()));
    _dir = pattern;
    _user = _dir / "settings.json";
    _admin = _dir / "admin.json";
  }
  void TearDown() override {
    std::error_code ec;
    std::filesystem::remove_all(_dir, ec);
    ZEPHostTest::TearDown();
  }
  std::filesystem::path _dir, _user, _admin;
};

// What a run of drafting-options ended with and said.
struct CliResult {
  int code = -1;
  std::string out, err;
};

// drafting-options iArgs..., run in this process.
inline CliResult RunInProcess(const std::vector<std::string>& iArgs) {
  std::vector<const char*> argv = {"drafting-options"};
  for (const std::string& a : iArgs) argv.push_back(a.c_str());
  std::ostringstream out, err;
  CliResult r;
  r.code = zepapp::RunCli(static_cast<int>(argv.size()), argv.data(), out, err);
  r.out = out.str();
  r.err = err.str();
  return r;
}

inline std::string ShellQuote(const std::string& s) {
  std::string q = "'";
  for (char c : s) q += c == '\'' ? std::string("'\\''") : std::string(1, c);
  return q + "'";
}

// iCommand run by the shell, its output streams kept in files of iDir.
inline CliResult RunShell(const std::string& iCommand, const std::filesystem::path& iDir) {
  const std::filesystem::path out = iDir / "out.txt", err = iDir / "err.txt";
  const std::string cmd = iCommand + " >" + ShellQuote(out.string()) + " 2>" + ShellQuote(err.string());
  const int status = std::system(("sh -c " + ShellQuote(cmd)).c_str());
  CliResult r;
  r.code = WIFEXITED(status) ? WEXITSTATUS(status) : -1;
  r.out = ReadBytes(out);
  r.err = ReadBytes(err);
  return r;
}
