// Helpers of the settings file tests: file contents and a temporary folder per test.
#pragma once

#include "TestSupport.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

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
