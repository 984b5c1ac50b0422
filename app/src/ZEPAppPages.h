// The pages of the application's drafting options dialog, bound to the settings store.
#pragma once

#include "ZEPAppBinding.h"

#include <functional>
#include <map>
#include <set>
#include <string>
#include <vector>

namespace zepapp {

struct ZEPAppPage {
  std::string name;  // command-line name: "grid"
  std::string title; // "Grid"
  std::string table; // the page's name in ZEPAppSettings.def: "Grid"
  // Constructs the page on iParent, builds and initialises it.
  std::function<ZEPDlgFrame*(ZEPDialog* iParent)> open;
  // How each attribute of the page is stored, from the page's table.
  std::map<std::string, ZEPAppStored> stored;
  // The push buttons that open sub-dialogs, in screen order.
  std::vector<std::string> dialogButtons;
  // Pages embedded in this one, by table name: their controls keep their own settings.
  std::vector<std::string> embedded;
  // The attributes a check button shows: stored as 0 or 1.
  std::set<std::string> flags;

  // Whether a row of ZEPAppSettings.def belongs to a control shown on this page.
  bool Shows(const ZEPAppSetting& iSetting) const;
};

const std::vector<ZEPAppPage>& AppPages();
const ZEPAppPage* FindPage(const std::string& iName);
// The page whose table holds a row of ZEPAppSettings.def (pages sharing a table store their
// rows alike); null when none.
const ZEPAppPage* TablePage(const ZEPAppSetting& iSetting);
// How a row is stored, as its page's table says; Unsupported when no page says.
ZEPAppStored StoredKindOf(const ZEPAppSetting& iSetting);

// The repositories the pages use, each opened once.
std::vector<std::string> AppRepositories();

// Settings that must agree with each other and do not, as sentences (the main page's PLM
// names and keys go in pairs: lists of different sizes show no PLM standard at all, and the
// next change of them replaces both). Call once the files are loaded.
std::vector<std::string> DisagreeingSettings();

// Puts the application's default of every setting into its repository, unless the
// administrator's file gave one. Call once the files are loaded.
void ApplyDefaults();

} // namespace zepapp
