// Shared test helpers: a clean host for each test and golden snapshots.
#pragma once

#include "ZEPHost.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <fstream>
#include <random>
#include <sstream>
#include <string>
#include <vector>

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

// The text of a combo's line ("" when there is none), and all its lines.
inline std::string ComboLine(const ZEPDlgCombo& iCombo, int iLine) {
  ZEPUnicodeString text;
  return iCombo.GetLine(text, iLine) < 0 ? "" : text.str();
}
inline std::vector<std::string> ComboLines(const ZEPDlgCombo& iCombo) {
  std::vector<std::string> lines;
  for (int i = 0; i < iCombo.GetLineCount(); ++i) lines.push_back(ComboLine(iCombo, i));
  return lines;
}

// A frame that records the notifications it hears: "<sender>:<kind>", and a radio's state then.
class NotificationRecorder : public ZEPDlgFrame {
public:
  explicit NotificationRecorder(ZEPDialog* iParent) : ZEPDlgFrame(iParent, "recorder") {}
  void Listen(ZEPCommand* iSender, ZEPNotification* iNotif) {
    AddAnalyseNotificationCB(iSender, iNotif, &NotificationRecorder::OnNotify, this);
  }
  std::vector<std::string> _events;
  ZEPCommand* _pLastSender = nullptr;

private:
  void OnNotify(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData) {
    EXPECT_EQ(iData, this);
    auto* w = ZEPSysDynamicCast<ZEPDialog>(iSender);
    auto* radio = ZEPSysDynamicCast<ZEPDlgRadioButton>(iSender);
    _events.push_back((w ? w->GetOwnName() : std::string("?")) + ":" + iNotif->GetKind() +
                      (radio ? (radio->GetState() == ZEPDlgChecked ? "=on" : "=off") : ""));
    _pLastSender = iSender;
  }
};

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

// iText with 1 to iMostEdits characters of iAlphabet put in place of one, inserted or removed,
// at random places: what a broken disk or a careless hand leaves of a file.
inline std::string Garbled(std::string iText, std::mt19937& ioRandom, const std::string& iAlphabet, int iMostEdits) {
  for (int k = 0, edits = 1 + static_cast<int>(ioRandom() % static_cast<unsigned>(iMostEdits)); k < edits; ++k) {
    const std::size_t pos = ioRandom() % iText.size();
    const char c = iAlphabet[ioRandom() % iAlphabet.size()];
    switch (ioRandom() % 3) {
    case 0: iText[pos] = c; break;
    case 1: iText.insert(pos, 1, c); break;
    default: iText.erase(pos, 1);
    }
  }
  return iText;
}
