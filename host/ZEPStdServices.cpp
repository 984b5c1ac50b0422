#include "ZEPStdServices.h"
#include "ZEPSystem.h"

#include <algorithm>
#include <filesystem>
#include <map>
#include <memory>
#include <system_error>

namespace {
struct StdState {
  std::string folder;
  // Explicit answers by type; a null entry stands for "no list".
  std::map<std::string, std::unique_ptr<std::vector<ZEPUnicodeString>>> lists;
};
StdState& State() {
  static StdState state;
  return state;
}

// Standard types are identifiers; anything else would reach outside the folder.
bool SafeType(const std::string& iType) {
  return !iType.empty() && iType != "." && iType != ".." &&
         iType.find_first_of("/\\") == std::string::npos;
}

ZEPListValZEPUnicodeString* ListFolder(const std::string& iType) {
  namespace fs = std::filesystem;
  if (!SafeType(iType)) return nullptr;
  std::error_code ec;
  fs::path dir = fs::path(ZEPStdSetup::GetStandardsFolder()) / iType;
  if (!fs::is_directory(dir, ec)) return nullptr;
  std::vector<std::string> names;
  for (fs::directory_iterator it(dir, ec), end; !ec && it != end; it.increment(ec))
    if (it->is_regular_file(ec)) names.push_back(it->path().filename().string());
  if (ec) return nullptr;
  std::sort(names.begin(), names.end());
  auto* list = new ZEPListValZEPUnicodeString;
  for (const std::string& n : names)
    list->Append(ZEPUnicodeString(n));
  return list;
}
} // namespace

ZEPListValZEPUnicodeString* ZEPStdServices::GetStandardFiles(ZEPUnicodeString& iType) {
  auto it = State().lists.find(iType.str());
  if (it == State().lists.end()) return ListFolder(iType.str());
  if (!it->second) return nullptr;
  auto* list = new ZEPListValZEPUnicodeString;
  for (const ZEPUnicodeString& n : *it->second)
    list->Append(n);
  return list;
}

void ZEPStdSetup::SetStandardsFolder(const std::string& iFolder) { State().folder = iFolder; }

std::string ZEPStdSetup::GetStandardsFolder() {
  return State().folder.empty() ? ZEPMsgCatalog::ResourceDir() + "/standards" : State().folder;
}

void ZEPStdSetup::SetStandardFiles(const ZEPUnicodeString& iType,
                                   const std::vector<ZEPUnicodeString>& iFiles) {
  State().lists[iType.str()] = std::make_unique<std::vector<ZEPUnicodeString>>(iFiles);
}

void ZEPStdSetup::SetNoList(const ZEPUnicodeString& iType) { State().lists[iType.str()].reset(); }

void ZEPStdSetup::Reset() {
  State().folder.clear();
  State().lists.clear();
}
