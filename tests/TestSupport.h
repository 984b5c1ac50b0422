// Shared test helpers: a clean host for each test and golden snapshots.
#pragma once

#include "ZEPHost.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <fstream>
#include <sstream>
#include <string>

// Compares iActual with tests/golden/<iName>. On mismatch writes <iName>.new beside it and
// fails with its path. ZEP_UPDATE_GOLDEN=1 rewrites the snapshot instead.
inline void ExpectGolden(const std::string& iName, const std::string& iActual) {
  const std::string path = std::string(ZEP_GOLDEN_DIR) + "/" + iName;
  if (std::getenv("ZEP_UPDATE_GOLDEN")) {
    std::ofstream(path, std::ios::binary) << iActual;
    return;
  }
  std::ifstream in(path, std::ios::binary);
  std::stringstream expected;
  expected << in.rdbuf();
  if (in && expected.str() == iActual) return;
  std::ofstream(path + ".new", std::ios::binary) << iActual;
  ADD_FAILURE() << "snapshot " << path << (in ? " differs" : " is missing") << "; the new dump is in " << path
                << ".new";
}

// iText holds iPart; the failure shows the whole text.
inline ::testing::AssertionResult Has(const std::string& iText, const std::string& iPart) {
  if (iText.find(iPart) != std::string::npos) return ::testing::AssertionSuccess();
  return ::testing::AssertionFailure() << "\"" << iPart << "\" is not in:\n" << iText;
}

// Every test starts from a host without repositories, checks or pending destructions.
class ZEPHostTest : public ::testing::Test {
protected:
  void SetUp() override { ResetHost(); }
  void TearDown() override { ResetHost(); }
  static void ResetHost() {
    ZEPDlgDriver::Idle();
    ZEPCheckLog::Clear();
    ZEPSysSettingRepository::CloseAll();
    ZEPSysPreferenceRepository::CloseAll();
    ZEPCkeUnitsSetup::Reset();
    ZEPScalesSetup::Reset();
    ZEPStdSetup::Reset();
    ZEPMessageBoxSetup::Reset();
    // The administration page shows a section when this is set: not from the shell.
    unsetenv("ZEP_TDE_LA");
    ZEPPLMSetup::Reset();
    ZEPScaleToolboxSetup::Reset();
    ZEPVidSetup::Reset();
  }
  // A top-level window that owns what a test builds on it.
  ZEPDlgWindow _root{nullptr, "root", 0};
};
