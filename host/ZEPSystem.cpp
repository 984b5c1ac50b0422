#include "ZEPSystem.h"

#include <array>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <map>
#include <memory>
#include <unordered_map>

// ---- strings ------------------------------------------------------------------------------
namespace {
bool IsContinuation(unsigned char c) { return (c & 0xC0) == 0x80; }
// Byte offsets at which each character starts.
std::vector<size_t> CharStarts(const std::string& s) {
  std::vector<size_t> starts;
  for (size_t i = 0; i < s.size(); ++i)
    if (!IsContinuation(static_cast<unsigned char>(s[i])) || starts.empty()) starts.push_back(i);
  return starts;
}
} // namespace

std::size_t ZEPFirstBadUtf8(const std::string& t) {
  const auto* s = reinterpret_cast<const unsigned char*>(t.data());
  const std::size_t n = t.size();
  std::size_t i = 0;
  while (i < n) {
    unsigned char c = s[i];
    if (c < 0x80) {
      ++i;
      continue;
    }
    int len = 0;
    unsigned char lo = 0x80, hi = 0xBF; // allowed range of the second byte
    if (c >= 0xC2 && c <= 0xDF) len = 2;
    else if (c >= 0xE0 && c <= 0xEF) {
      len = 3;
      if (c == 0xE0) lo = 0xA0;
      if (c == 0xED) hi = 0x9F;
    } else if (c >= 0xF0 && c <= 0xF4) {
      len = 4;
      if (c == 0xF0) lo = 0x90;
      if (c == 0xF4) hi = 0x8F;
    } else return i;
    if (i + 1 >= n || s[i + 1] < lo || s[i + 1] > hi) return i;
    for (int k = 2; k < len; ++k)
      if (i + k >= n || (s[i + k] & 0xC0) != 0x80) return i;
    i += len;
  }
  return std::string::npos;
}

int ZEPUnicodeString::GetLengthInChar() const { return static_cast<int>(CharStarts(_sText).size()); }

ZEPUnicodeString ZEPUnicodeString::SubString(int iStart, int iLength) const {
  std::vector<size_t> starts = CharStarts(_sText);
  int n = static_cast<int>(starts.size());
  if (iStart < 0) iStart = 0;
  if (iStart >= n || iLength <= 0) return ZEPUnicodeString();
  int end = iStart + iLength > n ? n : iStart + iLength;
  size_t b = starts[static_cast<size_t>(iStart)];
  size_t e = end == n ? _sText.size() : starts[static_cast<size_t>(end)];
  return ZEPUnicodeString(_sText.substr(b, e - b));
}

ZEPUnicodeString ZEPUnicodeString::ToLower() const {
  std::string s = _sText;
  for (char& c : s)
    if (c >= 'A' && c <= 'Z') c = static_cast<char>(c - 'A' + 'a');
  return ZEPUnicodeString(s);
}

void ZEPUnicodeString::RemoveTail(int iCount) {
  int n = GetLengthInChar();
  *this = SubString(0, n - iCount);
}

// ---- object model ---------------------------------------------------------------------------
ZEPMetaObject::ZEPMetaObject(const char* iName, const ZEPMetaObject* iBase, const char* iExtendedType,
                             const char* iFramework, ZEPCreateItselfFct iCreate)
    : _pName(iName), _pBase(iBase), _pExtended(iExtendedType), _pFramework(iFramework), _pCreate(iCreate) {}

namespace {
// Registered classes by name; the strings are kept with them.
struct Registered {
  std::string name, extended, framework;
  std::unique_ptr<ZEPMetaObject> meta;
};
std::map<std::string, Registered>& Registry() {
  static std::map<std::string, Registered> registry;
  return registry;
}
} // namespace

const ZEPMetaObject* fct_RetrieveMetaObject(const char* iName, const ZEPMetaObject* iBase, const char* iExtendedType,
                                            const char* iFramework, ZEPCreateItselfFct iCreate) {
  if (!iName || !*iName) return nullptr;
  auto [it, added] = Registry().try_emplace(iName);
  Registered& r = it->second;
  if (added) {
    r.name = iName;
    r.extended = iExtendedType ? iExtendedType : "";
    r.framework = iFramework ? iFramework : "";
    r.meta = std::make_unique<ZEPMetaObject>(r.name.c_str(), iBase, r.extended.c_str(), r.framework.c_str(), iCreate);
  }
  return r.meta.get();
}

const ZEPMetaObject* ZEPFindMetaObject(const char* iName) {
  auto it = iName ? Registry().find(iName) : Registry().end();
  return it == Registry().end() ? nullptr : it->second.meta.get();
}

bool ZEPMetaObject::IsAKindOf(const ZEPMetaObject* iOther) const {
  for (const ZEPMetaObject* m = this; m; m = m->_pBase)
    if (m == iOther) return true;
  return false;
}

bool ZEPMetaObject::IsAKindOf(const char* iName) const {
  if (!iName) return false;
  for (const ZEPMetaObject* m = this; m; m = m->_pBase)
    if (std::strcmp(m->_pName, iName) == 0) return true;
  return false;
}

const ZEPMetaObject* ZEPBaseUnknown::MetaObject() {
  static const ZEPMetaObject meta("ZEPBaseUnknown", nullptr);
  return &meta;
}

ZEPBaseUnknown* ZEPSysDynamicCast(const ZEPMetaObject* iMeta, ZEPBaseUnknown* iObject) {
  if (!iMeta || !iObject) return nullptr;
  return iObject->GetMetaObject()->IsAKindOf(iMeta) ? iObject : nullptr;
}

// ---- checks ---------------------------------------------------------------------------------
namespace {
std::vector<ZEPCheckEntry>& Log() {
  static std::vector<ZEPCheckEntry> entries;
  return entries;
}
} // namespace

const std::vector<ZEPCheckEntry>& ZEPCheckLog::Entries() { return Log(); }
int ZEPCheckLog::Count() { return static_cast<int>(Log().size()); }
bool ZEPCheckLog::Contains(const std::string& iExpression) {
  for (const ZEPCheckEntry& e : Log())
    if (e.expression == iExpression) return true;
  return false;
}
void ZEPCheckLog::Clear() { Log().clear(); }
void ZEPCheckLog::Add(const char* iReporter, const char* iExpression, const char* iPath, int iLine) {
  ZEPCheckEntry e{iReporter ? iReporter : "", iExpression ? iExpression : "", iPath ? iPath : "", iLine};
  if (ZEPGetEnv("ZEP_CHECK_STDERR"))
    std::fprintf(stderr, "%s: %s (%s:%d)\n", e.reporter.c_str(), e.expression.c_str(), e.path.c_str(), e.line);
  Log().push_back(std::move(e));
}

void Check_Pointer_Failed__(const char* iExpression, const char* iPath, int iLine, const char*) {
  ZEPCheckLog::Add("Check_Pointer_Failed__", iExpression, iPath, iLine);
}
void Check_TRUE_Failed__(const char* iExpression, const char* iPath, int iLine, const char*) {
  ZEPCheckLog::Add("Check_TRUE_Failed__", iExpression, iPath, iLine);
}
void CheckFailure__(const char* iExpression, const char* iPath, int iLine, const char*) {
  ZEPCheckLog::Add("CheckFailure__", iExpression, iPath, iLine);
}
void Check_Handler_Failed__(const char* iExpression, const char* iPath, int iLine, const char*) {
  ZEPCheckLog::Add("Check_Handler_Failed__", iExpression, iPath, iLine);
}

// ---- environment and catalogs ------------------------------------------------------------------
const char* ZEPGetEnv(const char* iName) { return iName ? std::getenv(iName) : nullptr; }

struct ZEPMsgCatalog::Loaded {
  std::map<std::string, std::string> keys;
  // Widget name -> its texts, pointing into keys.
  std::unordered_map<std::string, std::array<const std::string*, WidgetTextCount>> widgets;
};

namespace {
using Catalog = ZEPMsgCatalog::Loaded;
std::map<std::string, Catalog>& Catalogs() {
  static std::map<std::string, Catalog> loaded;
  return loaded;
}
unsigned& CatalogGeneration() {
  static unsigned generation = 0;
  return generation;
}

// Parses lines of the form: Key = "text";  with \" \\ \n escapes.
Catalog LoadCatalog(const std::string& iPath) {
  Catalog cat;
  std::ifstream in(iPath);
  std::string line;
  while (std::getline(in, line)) {
    size_t p = line.find_first_not_of(" \t");
    if (p == std::string::npos || line[p] == '#') continue;
    size_t eq = line.find('=', p);
    if (eq == std::string::npos) continue;
    std::string key = line.substr(p, eq - p);
    while (!key.empty() && (key.back() == ' ' || key.back() == '\t')) key.pop_back();
    size_t q = line.find('"', eq);
    if (q == std::string::npos || key.empty()) continue;
    std::string text;
    bool closed = false;
    for (size_t i = q + 1; i < line.size(); ++i) {
      char c = line[i];
      if (c == '\\' && i + 1 < line.size()) {
        char n = line[++i];
        text += n == 'n' ? '\n' : n;
      } else if (c == '"') {
        closed = true;
        break;
      } else {
        text += c;
      }
    }
    if (closed) cat.keys[key] = text;
  }
  static const char* const kSuffixes[ZEPMsgCatalog::WidgetTextCount] = {"Title", "Help", "ShortHelp", "LongHelp"};
  for (const auto& [key, text] : cat.keys) {
    const size_t dot = key.rfind('.');
    if (dot == std::string::npos) continue;
    for (int k = 0; k < ZEPMsgCatalog::WidgetTextCount; ++k)
      if (key.compare(dot + 1, std::string::npos, kSuffixes[k]) == 0) cat.widgets[key.substr(0, dot)][k] = &text;
  }
  return cat;
}

const Catalog& GetCatalog(const std::string& iName) {
  auto it = Catalogs().find(iName);
  if (it != Catalogs().end()) return it->second;
  Catalog cat;
  // Catalog names are identifiers; anything else would reach outside the folder.
  bool safe = !iName.empty() && iName.find_first_of("/\\.") == std::string::npos;
  if (safe) cat = LoadCatalog(ZEPMsgCatalog::ResourceDir() + "/catalogs/" + iName + ".msg");
  return Catalogs().emplace(iName, std::move(cat)).first->second;
}
} // namespace

const ZEPMsgCatalog::Loaded& ZEPMsgCatalog::Get(const ZEPString& iCatalog) { return GetCatalog(iCatalog); }

const std::string* const* ZEPMsgCatalog::FindWidget(const Loaded& iCatalog, const std::string& iName) {
  auto it = iCatalog.widgets.find(iName);
  return it == iCatalog.widgets.end() ? nullptr : it->second.data();
}

unsigned ZEPMsgCatalog::Generation() { return CatalogGeneration(); }

namespace {
bool HasCatalogs(const std::string& iDir) {
  std::error_code ec;
  return !iDir.empty() && std::filesystem::is_directory(iDir + "/catalogs", ec);
}

// The folder of the running program; empty when it cannot be told.
std::string ProgramDir() {
  std::error_code ec;
  const std::filesystem::path exe = std::filesystem::read_symlink("/proc/self/exe", ec);
  return ec ? std::string() : exe.parent_path().string();
}
} // namespace

// ZEP_RESOURCES when set; else the first folder that holds catalogs: beside an installed program
// (<prefix>/bin/../share/drafting-options), the source tree the host was built from, the
// installation folder it was configured for. Looked up once.
std::string ZEPMsgCatalog::ResourceDir() {
  if (const char* env = ZEPGetEnv("ZEP_RESOURCES")) return env;
  static const std::string found = [] {
    std::vector<std::string> candidates;
    const std::string program = ProgramDir();
    if (!program.empty()) candidates.push_back(program + "/../share/drafting-options");
#ifdef ZEP_RESOURCE_DIR
    candidates.push_back(ZEP_RESOURCE_DIR);
#endif
#ifdef ZEP_INSTALL_RESOURCE_DIR
    candidates.push_back(ZEP_INSTALL_RESOURCE_DIR);
#endif
    for (const std::string& dir : candidates)
      if (HasCatalogs(dir)) return std::filesystem::path(dir).lexically_normal().string();
    return candidates.empty() ? std::string("resources") : candidates.back();
  }();
  return found;
}

void ZEPMsgCatalog::Reset() {
  Catalogs().clear();
  ++CatalogGeneration();
}

bool ZEPMsgCatalog::Find(const ZEPString& iCatalog, const ZEPString& iKey, ZEPUnicodeString& oText) {
  const Catalog& cat = GetCatalog(iCatalog);
  auto it = cat.keys.find(iKey);
  if (it == cat.keys.end()) return false;
  oText = ZEPUnicodeString(it->second);
  return true;
}

ZEPUnicodeString ZEPMsgCatalog::BuildMessage(const ZEPString& iCatalog, const ZEPString& iKey,
                                             const ZEPUnicodeString* iParams, int iParamCount,
                                             const ZEPUnicodeString& iDefault, void*) {
  ZEPUnicodeString text;
  if (!Find(iCatalog, iKey, text)) return iDefault;
  if (!iParams || iParamCount <= 0) return text;
  // Parameters replace /p1, /p2, ... in order.
  std::string s = text.str();
  for (int i = iParamCount; i >= 1; --i) {
    std::string tag = "/p" + std::to_string(i);
    for (size_t at = s.find(tag); at != std::string::npos; at = s.find(tag, at + iParams[i - 1].str().size()))
      s.replace(at, tag.size(), iParams[i - 1].str());
  }
  return ZEPUnicodeString(s);
}
