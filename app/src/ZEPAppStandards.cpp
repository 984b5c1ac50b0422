#include "ZEPAppStandards.h"

#include "ZEPAppAtomicFile.h"
#include "ZEPAppSettingsFormat.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <set>

namespace zepapp {

namespace {
// A repository file is a short list: anything larger is not one.
constexpr std::size_t kMaxRepositorySize = 16u << 20;

std::string FromOptionOrEnv(const std::string& iOption, const char* iVariable) {
  if (!iOption.empty()) return iOption;
  const char* value = std::getenv(iVariable);
  return value && *value ? value : "";
}
} // namespace

std::string ResolveStandardsFolder(const std::string& iOption) {
  const std::string given = FromOptionOrEnv(iOption, kStandardsFolderEnv);
  return given.empty() ? ZEPMsgCatalog::ResourceDir() + "/standards" : given;
}

std::string ResolvePLMRepository(const std::string& iOption) {
  const std::string given = FromOptionOrEnv(iOption, kPLMRepositoryEnv);
  return given.empty() ? ZEPMsgCatalog::ResourceDir() + "/plm/standards.json" : given;
}

std::string UseStandardsFolder(const std::string& iFolder) {
  ZEPStdSetup::SetStandardsFolder(iFolder);
  std::error_code ec;
  if (!std::filesystem::is_directory(iFolder, ec))
    return "no standards folder " + iFolder + ": no folder standard is offered";
  if (!std::filesystem::is_directory(iFolder + "/drafting", ec))
    return "the standards folder " + iFolder +
           " has no \"drafting\" folder: no folder standard is offered";
  return "";
}

bool LoadPLMRepository(const std::string& iPath, std::string& oError) {
  ZEPPLMSetup::SetRepository({});
  std::string text, why;
  bool exists = false;
  if (!ReadRegularFile(iPath, kMaxRepositorySize, text, exists, why)) {
    oError = iPath + " " + why;
    return false;
  }
  if (!exists) {
    oError = iPath + ": no such PLM repository file";
    return false;
  }
  nlohmann::json doc;
  try {
    doc = nlohmann::json::parse(text);
  } catch (const nlohmann::json::parse_error& e) {
    ZEPAppFileError error;
    error.path = iPath;
    LineAndColumn(text, e.byte > 0 ? e.byte - 1 : 0, error.line, error.column);
    const std::string what = e.what();
    const auto at = what.find("syntax error");
    error.message = "not JSON: " + (at == std::string::npos ? what : what.substr(at));
    oError = error.Text();
    return false;
  }
  // The first fault, placed at its member.
  auto fault = [&](const std::vector<std::string>& iKeys, bool iAtKey, const std::string& iWhy) {
    oError = PlaceMessages(text, iPath, {{JsonPointer(iKeys), iAtKey, iWhy}}).front().Text();
    return false;
  };
  if (!doc.is_object() || !doc.contains("standards"))
    return fault({}, false, "expected an object with a \"standards\" array");
  for (const auto& [key, value] : doc.items())
    if (key != "standards") return fault({key}, true, "unknown member \"" + key + "\"");
  const nlohmann::json& list = doc["standards"];
  if (!list.is_array()) return fault({"standards"}, false, "\"standards\" must be an array");
  std::vector<ZEPPLMSetup::Standard> standards;
  std::set<std::string> keys;
  for (std::size_t i = 0; i < list.size(); ++i) {
    const std::string at = std::to_string(i);
    const nlohmann::json& entry = list[i];
    if (!entry.is_object())
      return fault({"standards", at}, false,
                   "a standard is an object with \"name\", \"key\" and \"unicity\"");
    ZEPPLMSetup::Standard standard;
    for (const auto& [member, value] : entry.items()) {
      if (member == "name" || member == "key") {
        const std::string text = value.is_string() ? value.get<std::string>() : std::string();
        const bool control = std::any_of(text.begin(), text.end(),
                                         [](char c) { return static_cast<unsigned char>(c) < 0x20; });
        if (text.empty() || control)
          return fault({"standards", at, member}, false,
                       "\"" + member + "\" must be a text that is not empty, without control characters");
        (member == "name" ? standard.name : standard.key) = value.get<std::string>();
      } else if (member == "unicity") {
        if (!value.is_number_integer() || value.get<long long>() < -1000000 ||
            value.get<long long>() > 1000000)
          return fault({"standards", at, member}, false, "\"unicity\" must be a whole number");
        standard.unicity = value.get<int>();
      } else {
        return fault({"standards", at, member}, true, "unknown member \"" + member + "\"");
      }
    }
    if (standard.name.empty())
      return fault({"standards", at}, false, "this standard has no \"name\"");
    if (standard.key.empty())
      return fault({"standards", at}, false, "this standard has no \"key\"");
    // Keys are what the settings keep: two standards with one key could not be told apart.
    if (!keys.insert(standard.key).second)
      return fault({"standards", at, "key"}, false,
                   "the key \"" + standard.key + "\" is given twice");
    standards.push_back(std::move(standard));
  }
  ZEPPLMSetup::SetRepository(std::move(standards));
  return true;
}

} // namespace zepapp
