#include "ZEPAppKeys.h"

#include <algorithm>
#include <cctype>

namespace zepapp {

namespace {
std::string Lower(std::string s) {
  for (char& c : s) c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
  return s;
}

// Edits (insert, delete, replace, swap of neighbours) from a to b.
std::size_t Distance(const std::string& a, const std::string& b) {
  std::vector<std::vector<std::size_t>> d(a.size() + 1, std::vector<std::size_t>(b.size() + 1));
  for (std::size_t i = 0; i <= a.size(); ++i) d[i][0] = i;
  for (std::size_t j = 0; j <= b.size(); ++j) d[0][j] = j;
  for (std::size_t i = 1; i <= a.size(); ++i)
    for (std::size_t j = 1; j <= b.size(); ++j) {
      d[i][j] = std::min({d[i - 1][j] + 1, d[i][j - 1] + 1, d[i - 1][j - 1] + (a[i - 1] == b[j - 1] ? 0 : 1)});
      if (i > 1 && j > 1 && a[i - 1] == b[j - 2] && a[i - 2] == b[j - 1]) d[i][j] = std::min(d[i][j], d[i - 2][j - 2] + 1);
    }
  return d[a.size()][b.size()];
}

const ZEPAppSetting* ByAttribute(const std::string& iName) {
  for (const ZEPAppSetting& s : AppSettings())
    if (s.stored == iName) return &s;
  const ZEPAppSetting* found = nullptr;
  for (const ZEPAppSetting& s : AppSettings())
    if (Lower(s.stored) == Lower(iName)) {
      if (found) return nullptr; // two differ only by case: the exact name is needed
      found = &s;
    }
  return found;
}

std::vector<std::string> PageNames() {
  std::vector<std::string> names;
  for (const ZEPAppPage& p : AppPages()) names.push_back(p.name);
  return names;
}

// Every single-word key: stored attributes and dotted controls.
std::vector<std::string> SingleKeys() {
  std::vector<std::string> keys;
  for (const ZEPAppSetting& s : AppSettings()) {
    keys.push_back(s.stored);
    if (const ZEPAppPage* p = PageOf(s)) keys.push_back(p->name + "." + s.control);
  }
  return keys;
}
} // namespace

const ZEPAppSetting* SettingOf(const ZEPAppPage& iPage, const std::string& iControl) {
  for (const ZEPAppSetting& s : AppSettings())
    if (iPage.Shows(s) && s.control == iControl) return &s;
  for (const ZEPAppSetting& s : AppSettings())
    if (iPage.Shows(s) && Lower(s.control) == Lower(iControl)) return &s;
  return nullptr;
}

const ZEPAppPage* PageOf(const ZEPAppSetting& iSetting) {
  if (const ZEPAppPage* page = TablePage(iSetting)) return page;
  for (const ZEPAppPage& p : AppPages())
    if (p.Shows(iSetting)) return &p;
  return nullptr;
}

std::vector<std::string> Closest(const std::string& iName, const std::vector<std::string>& iCandidates,
                                 std::size_t iMax) {
  const std::string name = Lower(iName);
  // A slip is a few edits, fewer for short names; a candidate that contains the name also counts.
  const std::size_t limit = std::max<std::size_t>(2, name.size() / 3);
  std::vector<std::pair<std::size_t, std::string>> scored;
  for (const std::string& c : iCandidates) {
    const std::string lower = Lower(c);
    std::size_t d = Distance(name, lower);
    if (name.size() >= 3 && lower.find(name) != std::string::npos) d = std::min(d, limit);
    if (d <= limit) scored.push_back({d, c});
  }
  std::stable_sort(scored.begin(), scored.end(), [](const auto& a, const auto& b) { return a.first < b.first; });
  std::vector<std::string> out;
  for (const auto& s : scored)
    if (out.size() < iMax && std::find(out.begin(), out.end(), s.second) == out.end()) out.push_back(s.second);
  return out;
}

std::string DidYouMean(const std::string& iName, const std::vector<std::string>& iCandidates) {
  const std::vector<std::string> near = Closest(iName, iCandidates);
  if (near.empty()) return "";
  std::string text = " Did you mean ";
  for (std::size_t i = 0; i < near.size(); ++i)
    text += (i == 0 ? "" : i + 1 == near.size() ? " or " : ", ") + near[i];
  return text + "?";
}

bool ResolveKey(const std::vector<std::string>& iArgs, ZEPAppKey& oKey, std::size_t& oUsed, std::string& oError) {
  oKey = ZEPAppKey();
  oUsed = 0;
  if (iArgs.empty()) {
    oError = "a setting is needed: PAGE CONTROL, PAGE.CONTROL or its stored attribute";
    return false;
  }
  const std::string& first = iArgs[0];
  if (const ZEPAppPage* page = FindPage(Lower(first))) {
    if (iArgs.size() < 2) {
      oError = "page " + page->name + " needs a control name ('show " + page->name + "' lists them)";
      return false;
    }
    oKey.page = page;
    oKey.control = iArgs[1];
    oKey.setting = SettingOf(*page, iArgs[1]);
    oUsed = 2;
    return true;
  }
  const std::size_t dot = first.find('.');
  if (dot != std::string::npos) {
    const ZEPAppPage* page = FindPage(Lower(first.substr(0, dot)));
    if (!page) {
      oError = "unknown page \"" + first.substr(0, dot) + "\"." + DidYouMean(first.substr(0, dot), PageNames());
      return false;
    }
    oKey.page = page;
    oKey.control = first.substr(dot + 1);
    oKey.setting = SettingOf(*page, oKey.control);
    oUsed = 1;
    return true;
  }
  if (const ZEPAppSetting* setting = ByAttribute(first)) {
    oKey.setting = setting;
    oKey.page = PageOf(*setting);
    oKey.control = setting->control;
    oUsed = 1;
    return oKey.page != nullptr;
  }
  std::vector<std::string> candidates = SingleKeys();
  for (const std::string& p : PageNames()) candidates.push_back(p);
  oError = "unknown setting \"" + first + "\": name it PAGE CONTROL, PAGE.CONTROL or by its stored attribute." +
           DidYouMean(first, candidates) + " 'drafting-options list' shows every setting.";
  return false;
}

} // namespace zepapp
