#include "ZEPAppSettingsFormat.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <charconv>
#include <climits>
#include <cmath>
#include <cstdint>
#include <cstring>
#include <set>
#include <string_view>
#include <utility>

namespace zepapp {

using json = nlohmann::json;

namespace {

constexpr std::size_t kNone = std::string::npos;
// Our files are five levels deep; anything far deeper is not a settings file, and refusing it
// early keeps the position pass below cheap.
constexpr int kMaxDepth = 32;
constexpr std::size_t kMaxFaults = 20;

const char* const kTypeKeys[] = {"double", "int", "unsigned", "text"};
// The kinds as the messages list them.
const char* const kKindsAnd = "\"double\", \"int\", \"unsigned\" and \"text\"";
const char* const kKindsOr = "\"double\", \"int\", \"unsigned\" or \"text\"";

std::size_t BomLength(const std::string& t) { return t.compare(0, 3, "\xEF\xBB\xBF") == 0 ? 3 : 0; }

bool IsJsonSpace(char c) { return c == ' ' || c == '\t' || c == '\n' || c == '\r'; }

std::size_t SkipSpace(const std::string& t, std::size_t i) {
  while (i < t.size() && IsJsonSpace(t[i])) ++i;
  return i;
}

// Offset where nesting first goes deeper than kMaxDepth, or kNone. Strings are skipped.
std::size_t TooDeep(const std::string& t) {
  int depth = 0;
  for (std::size_t i = 0; i < t.size(); ++i) {
    char c = t[i];
    if (c == '"') {
      for (++i; i < t.size() && t[i] != '"'; ++i)
        if (t[i] == '\\') ++i;
    } else if (c == '[' || c == '{') {
      if (++depth > kMaxDepth) return i;
    } else if (c == ']' || c == '}') --depth;
  }
  return kNone;
}

// Builds the document like nlohmann's own parser but keeps the place of a syntax error,
// including the number overflows its throwing interface reports without one.
class PlacedParser {
public:
  explicit PlacedParser(json& oRoot) : _dom(oRoot, false) {}
  bool null() { return _dom.null(); }
  bool boolean(bool v) { return _dom.boolean(v); }
  bool number_integer(json::number_integer_t v) { return _dom.number_integer(v); }
  bool number_unsigned(json::number_unsigned_t v) { return _dom.number_unsigned(v); }
  bool number_float(json::number_float_t v, const std::string& s) { return _dom.number_float(v, s); }
  bool string(std::string& v) { return _dom.string(v); }
  bool binary(json::binary_t& v) { return _dom.binary(v); }
  bool start_object(std::size_t n) { return _dom.start_object(n); }
  bool key(std::string& v) { return _dom.key(v); }
  bool end_object() { return _dom.end_object(); }
  bool start_array(std::size_t n) { return _dom.start_array(n); }
  bool end_array() { return _dom.end_array(); }
  bool parse_error(std::size_t iPos, const std::string& iToken, const nlohmann::detail::exception& iEx) {
    // iPos counts the characters read, the failing one included.
    if (iEx.id == 406) { // number overflow: iPos is just past the number and one character more
      _offset = iPos > iToken.size() ? iPos - iToken.size() : 0;
      _message = "the number " + iToken + " is too large";
    } else {
      _offset = iPos > 0 ? iPos - 1 : 0;
      _message = iEx.what();
      // "[json.exception.parse_error.101] parse error at line 1, column 8: syntax error ..."
      std::size_t at = _message.find("parse error");
      std::size_t colon = at == kNone ? kNone : _message.find(": ", at);
      if (colon != kNone) _message = _message.substr(colon + 2);
    }
    return false;
  }
  std::size_t Offset() const { return _offset; }
  const std::string& Message() const { return _message; }

private:
  nlohmann::detail::json_sax_dom_parser<json> _dom;
  std::size_t _offset = 0;
  std::string _message;
};

std::string EscapePointer(const std::string& iKey) {
  std::string out;
  for (char c : iKey) {
    if (c == '~') out += "~0";
    else if (c == '/') out += "~1";
    else out += c;
  }
  return out;
}

std::size_t SkipString(const std::string& t, std::size_t i) {
  for (++i; i < t.size(); ++i) {
    if (t[i] == '\\') ++i;
    else if (t[i] == '"') return i + 1;
  }
  return t.size();
}

std::size_t SkipScalar(const std::string& t, std::size_t i) {
  while (i < t.size() && !IsJsonSpace(t[i]) && t[i] != ',' && t[i] != ']' && t[i] != '}') ++i;
  return i;
}

// Byte offsets of the values and keys of a well-formed document, by JSON pointer. nlohmann's
// tree has no positions, so a second light pass over the text finds them. A repeated key is
// remembered: the tree silently keeps only its last value.
struct Positions {
  std::map<std::string, std::size_t> values, keys;
  std::string duplicate;
  std::size_t duplicateAt = kNone;
};

Positions Locate(const std::string& t) {
  struct Frame {
    bool object;
    std::string pointer;
    std::size_t count;
    std::set<std::string> keys;
  };
  Positions p;
  std::vector<Frame> stack;
  std::string pointer;
  std::size_t i = SkipSpace(t, BomLength(t));
  while (i < t.size()) {
    p.values[pointer] = i;
    bool complete = true;
    if (t[i] == '{' || t[i] == '[') {
      const char close = t[i] == '{' ? '}' : ']';
      stack.push_back(Frame{t[i] == '{', pointer, 0, {}});
      i = SkipSpace(t, i + 1);
      if (i < t.size() && t[i] == close) {
        stack.pop_back();
        ++i;
      } else complete = false;
    } else i = t[i] == '"' ? SkipString(t, i) : SkipScalar(t, i);
    // After a complete value a comma starts the next member, a bracket closes its container.
    while (complete) {
      if (stack.empty()) return p;
      i = SkipSpace(t, i);
      if (i >= t.size()) return p;
      if (t[i] == ',') {
        i = SkipSpace(t, i + 1);
        ++stack.back().count;
        complete = false;
      } else {
        ++i;
        stack.pop_back();
      }
    }
    Frame& f = stack.back();
    if (!f.object) {
      pointer = f.pointer + "/" + std::to_string(f.count);
      continue;
    }
    const std::size_t keyAt = i;
    const std::size_t end = SkipString(t, i);
    json key = json::parse(t.begin() + static_cast<std::ptrdiff_t>(keyAt), t.begin() + static_cast<std::ptrdiff_t>(end),
                           nullptr, false);
    const std::string name = key.is_string() ? key.get<std::string>() : t.substr(keyAt, end - keyAt);
    pointer = f.pointer + "/" + EscapePointer(name);
    if (!f.keys.insert(name).second && p.duplicateAt == kNone) {
      p.duplicate = name;
      p.duplicateAt = keyAt;
    }
    p.keys[pointer] = keyAt;
    i = SkipSpace(t, end);
    if (i < t.size() && t[i] == ':') ++i;
    i = SkipSpace(t, i);
  }
  return p;
}

std::string Describe(const json& j) {
  switch (j.type()) {
  case json::value_t::string: return "a string";
  case json::value_t::array: return "an array";
  case json::value_t::object: return "an object";
  case json::value_t::null: return "null";
  default: return j.dump();
  }
}

// Checks a parsed document against the format, noting each fault at its place.
class Checker {
public:
  Checker(Positions iPos, bool iAdmin) : _pos(std::move(iPos)), _admin(iAdmin) {}

  void Document(const json& iRoot, ZEPAppSettingsDoc& oDoc) {
    if (_pos.duplicateAt != kNone)
      Fault(_pos.duplicateAt, "the key \"" + _pos.duplicate + "\" appears twice; one of its values would be lost");
    if (!iRoot.is_object()) {
      Fault(ValueAt(""), "expected an object with \"format\", \"settings\" and \"preferences\", found " +
                             Describe(iRoot));
      return;
    }
    for (const auto& [key, value] : iRoot.items()) {
      const std::string ptr = "/" + EscapePointer(key);
      if (key == "format") {
        if (!value.is_number_integer() || value.get<long long>() != kSettingsFormat)
          Fault(ValueAt(ptr), "unsupported format " + value.dump() + "; this program reads format " +
                                  std::to_string(kSettingsFormat));
      } else if (key == "settings") {
        Section(value, ptr, oDoc.settings);
      } else if (key == "preferences") {
        Section(value, ptr, oDoc.preferences);
      } else {
        Fault(KeyAt(ptr), "unknown key \"" + key + "\"; expected \"format\", \"settings\" or \"preferences\"");
      }
    }
  }

  std::vector<std::pair<std::size_t, std::string>>& Faults() { return _faults; }

private:
  std::size_t ValueAt(const std::string& iPtr) const {
    auto it = _pos.values.find(iPtr);
    return it == _pos.values.end() ? 0 : it->second;
  }
  std::size_t KeyAt(const std::string& iPtr) const {
    auto it = _pos.keys.find(iPtr);
    return it == _pos.keys.end() ? ValueAt(iPtr) : it->second;
  }
  void Fault(std::size_t iOffset, std::string iMessage) { _faults.emplace_back(iOffset, std::move(iMessage)); }

  void Section(const json& iSection, const std::string& iPtr, std::map<std::string, ZEPAppRepoEntries>& oRepos) {
    const std::string section = iPtr.substr(1);
    if (!iSection.is_object()) {
      Fault(ValueAt(iPtr), "\"" + section + "\" must be an object of repositories by name, found " +
                               Describe(iSection));
      return;
    }
    for (const auto& [repo, attrs] : iSection.items()) {
      const std::string repoPtr = iPtr + "/" + EscapePointer(repo);
      if (repo.empty()) {
        Fault(KeyAt(repoPtr), "a repository needs a name");
        continue;
      }
      if (!attrs.is_object()) {
        Fault(ValueAt(repoPtr), section + "/" + repo + ": expected an object of attributes, found " + Describe(attrs));
        continue;
      }
      ZEPAppRepoEntries& entries = oRepos[repo];
      for (const auto& [attr, entry] : attrs.items()) {
        const std::string attrPtr = repoPtr + "/" + EscapePointer(attr);
        const std::string where = section + "/" + repo + "/" + attr + ": ";
        if (attr.empty()) Fault(KeyAt(attrPtr), section + "/" + repo + ": an attribute needs a name");
        else Entry(entry, attrPtr, where, entries[attr]);
      }
    }
  }

  void Entry(const json& iEntry, const std::string& iPtr, const std::string& iWhere, ZEPAppAttrEntry& oEntry) {
    if (!iEntry.is_object()) {
      Fault(ValueAt(iPtr), iWhere + "expected an object such as {\"int\": 1}, found " + Describe(iEntry));
      return;
    }
    const std::size_t before = _faults.size();
    for (const auto& [key, value] : iEntry.items()) {
      const std::string ptr = iPtr + "/" + EscapePointer(key);
      const bool isType = std::find(std::begin(kTypeKeys), std::end(kTypeKeys), key) != std::end(kTypeKeys);
      if (isType) {
        if (oEntry.value) Fault(KeyAt(ptr), iWhere + "holds more than one of " + kKindsAnd);
        else Values(key, value, ptr, iWhere, oEntry);
      } else if ((key == "locked" || key == "by") && !_admin) {
        Fault(KeyAt(ptr), iWhere + "\"" + key + "\" belongs in the administrator's file");
      } else if (key == "locked") {
        if (value.is_boolean()) oEntry.locked = value.get<bool>();
        else Fault(ValueAt(ptr), iWhere + "\"locked\" must be true or false, found " + Describe(value));
      } else if (key == "by") {
        if (value.is_string()) oEntry.by = value.get<std::string>();
        else Fault(ValueAt(ptr), iWhere + "\"by\" must be a string, found " + Describe(value));
      } else {
        Fault(KeyAt(ptr), iWhere + "unknown key \"" + key + "\"; expected " + kKindsOr +
                              (_admin ? ", \"locked\" or \"by\"" : ""));
      }
    }
    if (_faults.size() == before && !oEntry.value && !oEntry.locked)
      Fault(ValueAt(iPtr), iWhere + "no value: expected " + kKindsOr);
  }

  void Values(const std::string& iType, const json& iValues, const std::string& iPtr, const std::string& iWhere,
              ZEPAppAttrEntry& oEntry) {
    const bool scalar = !iValues.is_array();
    const std::size_t n = scalar ? 1 : iValues.size();
    std::vector<double> d;
    std::vector<int> s;
    std::vector<unsigned int> u;
    std::vector<std::string> texts;
    bool ok = true;
    for (std::size_t k = 0; k < n; ++k) {
      const json& v = scalar ? iValues : iValues[k];
      const std::string ptr = scalar ? iPtr : iPtr + "/" + std::to_string(k);
      const std::string where = iWhere + iType + (scalar ? "" : "[" + std::to_string(k) + "]") + ": ";
      if (iType == "text") {
        // The whole file is valid UTF-8 by now, and nlohmann refuses a \u escape of half a pair.
        if (!v.is_string()) {
          Fault(ValueAt(ptr), where + "expected a text, found " + Describe(v));
          ok = false;
        } else if (v.get_ref<const std::string&>().find('\0') != std::string::npos) {
          Fault(ValueAt(ptr), where + "a text cannot hold the character \\u0000");
          ok = false;
        } else texts.push_back(v.get<std::string>());
      } else if (iType == "double") {
        if (v.is_number() && std::isfinite(v.get<double>())) d.push_back(v.get<double>());
        else {
          Fault(ValueAt(ptr), where + "expected a finite number, found " + Describe(v));
          ok = false;
        }
      } else if (iType == "int") {
        bool fits = v.is_number_unsigned() ? v.get<std::uint64_t>() <= INT_MAX
                    : v.is_number_integer()
                        ? v.get<std::int64_t>() >= INT_MIN && v.get<std::int64_t>() <= INT_MAX
                        : false;
        if (fits) s.push_back(v.get<int>());
        else {
          Fault(ValueAt(ptr), where + "expected an integer from " + std::to_string(INT_MIN) + " to " +
                                  std::to_string(INT_MAX) + ", found " + Describe(v));
          ok = false;
        }
      } else {
        bool fits = v.is_number_unsigned() ? v.get<std::uint64_t>() <= UINT_MAX
                    : v.is_number_integer() ? v.get<std::int64_t>() >= 0 && v.get<std::int64_t>() <= UINT_MAX
                                            : false;
        if (fits) u.push_back(v.get<unsigned int>());
        else {
          Fault(ValueAt(ptr), where + "expected an unsigned integer from 0 to " + std::to_string(UINT_MAX) +
                                  ", found " + Describe(v));
          ok = false;
        }
      }
    }
    if (!ok) return;
    if (iType == "double") oEntry.value = std::move(d);
    else if (iType == "text") oEntry.value = std::move(texts);
    else if (iType == "int") oEntry.value = std::move(s);
    else oEntry.value = std::move(u);
  }

  const Positions _pos;
  bool _admin;
  std::vector<std::pair<std::size_t, std::string>> _faults;
};

} // namespace

std::string ZEPAppFileError::Text() const {
  std::string out = path;
  if (line > 0) out += ":" + std::to_string(line) + ":" + std::to_string(column);
  return out + ": " + message;
}

void LineAndColumn(const std::string& iText, std::size_t iOffset, int& oLine, int& oColumn) {
  oLine = 1;
  oColumn = 1;
  const std::size_t end = std::min(iOffset, iText.size());
  for (std::size_t i = 0; i < end; ++i) {
    const unsigned char c = static_cast<unsigned char>(iText[i]);
    if (c == '\n') {
      ++oLine;
      oColumn = 1;
    } else if ((c & 0xC0) != 0x80) {
      ++oColumn;
    }
  }
}

bool IsFinite(const ZEPAppValue& iValue, std::size_t* oIndex) {
  const auto* d = std::get_if<std::vector<double>>(&iValue);
  if (!d) return true;
  for (std::size_t k = 0; k < d->size(); ++k)
    if (!std::isfinite((*d)[k])) {
      if (oIndex) *oIndex = k;
      return false;
    }
  return true;
}

std::string Unstorable(const ZEPAppValue& iValue) {
  std::size_t bad = 0;
  if (!IsFinite(iValue, &bad)) return "value " + std::to_string(bad + 1) + " is not a finite number";
  if (const auto* texts = std::get_if<std::vector<std::string>>(&iValue))
    for (std::size_t k = 0; k < texts->size(); ++k) {
      const std::string& text = (*texts)[k];
      if (ZEPFirstBadUtf8(text) != kNone) return "text " + std::to_string(k + 1) + " is not valid UTF-8";
      if (text.find('\0') != kNone) return "text " + std::to_string(k + 1) + " holds a NUL character";
    }
  return "";
}

namespace {
// The quick pass: reads a well-formed settings file straight into the document, in one pass
// over the text, and gives up at the first thing it does not expect (anything the thorough
// pass would report, and a few rare forms it leaves to it: \u escapes, integers beyond 64
// bits). Nothing is placed or described here; the thorough pass does that for a file that
// has something to report.
class QuickReader {
public:
  QuickReader(const std::string& iText, bool iAdmin)
      : _p(iText.data()), _end(iText.data() + iText.size()), _admin(iAdmin) {}

  // Into a document, or into the values of a user's file (ZEPAppSettingsValues).
  template <class Doc> bool Document(Doc& oDoc) {
    if (_end - _p >= 3 && std::memcmp(_p, "\xEF\xBB\xBF", 3) == 0) _p += 3;
    bool format = false, settings = false, preferences = false;
    Space();
    if (!Take('{')) return false;
    Space();
    if (!Take('}')) {
      do {
        Space();
        std::string_view key;
        if (!String(key)) return false;
        if (!Colon()) return false;
        if (key == "format") {
          if (format || !Literal("1")) return false;
          format = true;
        } else if (key == "settings") {
          if (settings || !Section(oDoc.settings)) return false;
          settings = true;
        } else if (key == "preferences") {
          if (preferences || !Section(oDoc.preferences)) return false;
          preferences = true;
        } else return false;
        Space();
      } while (Take(','));
      if (!Take('}')) return false;
    }
    Space();
    return _p == _end;
  }

private:
  static bool IsSpace(char c) { return c == ' ' || c == '\n' || c == '\r' || c == '\t'; }
  void Space() {
    while (_p != _end && IsSpace(*_p)) ++_p;
  }
  bool Take(char c) {
    if (_p == _end || *_p != c) return false;
    ++_p;
    return true;
  }
  bool Colon() {
    Space();
    if (!Take(':')) return false;
    Space();
    return true;
  }
  // A literal or number that must be exactly iWord, followed by what may follow a value.
  bool Literal(const char* iWord) {
    const std::size_t n = std::strlen(iWord);
    if (static_cast<std::size_t>(_end - _p) < n || std::memcmp(_p, iWord, n) != 0) return false;
    _p += n;
    return _p == _end || IsSpace(*_p) || *_p == ',' || *_p == '}' || *_p == ']';
  }
  // A string without \u escapes: a view of the text itself, or of _unescaped when it holds
  // escapes (valid until the next string).
  bool String(std::string_view& oText) {
    if (!Take('"')) return false;
    const char* const start = _p;
    bool ascii = true, escaped = false;
    for (; _p != _end && *_p != '"'; ++_p) {
      const unsigned char c = static_cast<unsigned char>(*_p);
      if (c < 0x20) return false;
      if (c >= 0x80) ascii = false;
      if (c == '\\') {
        escaped = true;
        if (++_p == _end) return false; // the escaped character is skipped, a quote included
      }
    }
    if (_p == _end) return false;
    oText = std::string_view(start, static_cast<std::size_t>(_p - start));
    ++_p;
    if (!ascii && ZEPFirstBadUtf8(std::string(oText)) != kNone) return false;
    return !escaped || Unescape(oText);
  }
  bool String(std::string& oText) {
    std::string_view text;
    if (!String(text)) return false;
    oText.assign(text.data(), text.size());
    return true;
  }
  // The escapes of ioText decoded into _unescaped, which ioText then views.
  bool Unescape(std::string_view& ioText) {
    _unescaped.clear();
    for (std::size_t i = 0; i < ioText.size(); ++i) {
      if (ioText[i] != '\\') {
        _unescaped += ioText[i];
        continue;
      }
      switch (ioText[++i]) {
      case '"': _unescaped += '"'; break;
      case '\\': _unescaped += '\\'; break;
      case '/': _unescaped += '/'; break;
      case 'b': _unescaped += '\b'; break;
      case 'f': _unescaped += '\f'; break;
      case 'n': _unescaped += '\n'; break;
      case 'r': _unescaped += '\r'; break;
      case 't': _unescaped += '\t'; break;
      default: return false;
      }
    }
    ioText = _unescaped;
    return true;
  }

  // Inserts iKey into a map whose keys usually come in order (as saved); false when it is there.
  template <class Map> typename Map::mapped_type* Insert(Map& ioMap, std::string_view iKey) {
    const std::size_t before = ioMap.size();
    auto it = ioMap.emplace_hint(ioMap.end(), iKey, typename Map::mapped_type()); // in order: no search
    return ioMap.size() > before ? &it->second : nullptr;
  }

  template <class Repo> bool Section(std::map<std::string, Repo>& oRepos) {
    if (!Take('{')) return false;
    Space();
    if (Take('}')) return true;
    do {
      Space();
      std::string_view key;
      if (!String(key) || key.empty() || !Colon()) return false;
      Repo* entries = Insert(oRepos, key);
      if (!entries || !Take('{')) return false;
      Space();
      if (Take('}')) continue;
      do {
        Space();
        if (!String(key) || key.empty() || !Colon()) return false;
        auto* entry = Insert(*entries, key);
        if (!entry || !Entry(*entry)) return false;
        Space();
      } while (Take(','));
      if (!Take('}')) return false;
      Space();
    } while (Take(','));
    return Take('}');
  }

  // An attribute: into a document's entry, or into the value alone (a user's file, where an
  // entry holds nothing else).
  template <class Out> bool Entry(Out& oEntry) {
    if (!Take('{')) return false;
    bool value = false, locked = false, by = false;
    Space();
    if (!Take('}')) {
      do {
        Space();
        std::string_view field;
        if (!String(field) || !Colon()) return false;
        if (field == "double" || field == "int" || field == "unsigned" || field == "text") {
          if (value) return false;
          value = true;
          ZEPAppValue& slot = Slot(oEntry);
          const bool ok = field[0] == 'd'   ? Values<double>(slot)
                          : field[0] == 'i' ? Values<int>(slot)
                          : field[0] == 'u' ? Values<unsigned int>(slot)
                                            : Values<std::string>(slot);
          if (!ok) return false;
        } else if (!_admin || !Lock(oEntry, field, locked, by)) {
          return false;
        }
        Space();
      } while (Take(','));
      if (!Take('}')) return false;
    }
    return value || locked;
  }
  static ZEPAppValue& Slot(ZEPAppAttrEntry& ioEntry) { return ioEntry.value.emplace(); }
  static ZEPAppValue& Slot(ZEPAppValue& ioValue) { return ioValue; }
  // "locked" or "by" of the administrator's file, each once.
  bool Lock(ZEPAppAttrEntry& oEntry, std::string_view iField, bool& ioLocked, bool& ioBy) {
    if (iField == "locked" && !ioLocked) {
      ioLocked = true;
      if (Literal("true")) oEntry.locked = true;
      else if (!Literal("false")) return false;
      return true;
    }
    if (iField == "by" && !ioBy) {
      ioBy = true;
      return String(oEntry.by);
    }
    return false;
  }
  bool Lock(ZEPAppValue&, std::string_view, bool&, bool&) { return false; }

  template <class T> bool Values(ZEPAppValue& oValue) {
    std::vector<T> values;
    T v{};
    if (Take('[')) {
      Space();
      if (!Take(']')) {
        values.reserve(5);
        do {
          Space();
          if (!Item(v)) return false;
          values.push_back(v);
          Space();
        } while (Take(','));
        if (!Take(']')) return false;
      }
    } else {
      if (!Item(v)) return false;
      values.push_back(v);
    }
    oValue.emplace<std::vector<T>>(std::move(values));
    return true;
  }
  // One value of a list: a number, or a text (String refuses \u escapes, so no NUL gets in).
  template <class T> bool Item(T& oValue) { return Number(oValue); }
  bool Item(std::string& oText) { return String(oText); }

  // A JSON number; oInteger: it has no fraction and no exponent.
  bool Token(const char*& oStart, bool& oInteger) {
    oStart = _p;
    if (_p != _end && *_p == '-') ++_p;
    if (_p == _end) return false;
    if (*_p == '0') ++_p;
    else if (*_p >= '1' && *_p <= '9')
      while (_p != _end && *_p >= '0' && *_p <= '9') ++_p;
    else return false;
    oInteger = true;
    if (_p != _end && *_p == '.') {
      oInteger = false;
      if (++_p == _end || *_p < '0' || *_p > '9') return false;
      while (_p != _end && *_p >= '0' && *_p <= '9') ++_p;
    }
    if (_p != _end && (*_p == 'e' || *_p == 'E')) {
      oInteger = false;
      if (++_p != _end && (*_p == '+' || *_p == '-')) ++_p;
      if (_p == _end || *_p < '0' || *_p > '9') return false;
      while (_p != _end && *_p >= '0' && *_p <= '9') ++_p;
    }
    return true;
  }
  bool Number(double& oValue) {
    const char* start;
    bool integer;
    if (!Token(start, integer)) return false;
    if (integer) { // as the thorough pass: a 64-bit integer, then converted
      if (*start == '-') {
        std::int64_t i;
        if (std::from_chars(start, _p, i).ec != std::errc()) return false;
        oValue = static_cast<double>(i);
      } else {
        std::uint64_t u;
        if (std::from_chars(start, _p, u).ec != std::errc()) return false;
        oValue = static_cast<double>(u);
      }
      return true;
    }
    const auto r = std::from_chars(start, _p, oValue);
    return r.ec == std::errc() && r.ptr == _p && std::isfinite(oValue);
  }
  template <class Int> bool Number(Int& oValue) {
    const char* start;
    bool integer;
    if (!Token(start, integer) || !integer) return false;
    if (std::from_chars(start, _p, oValue).ec == std::errc()) return true;
    oValue = 0; // "-0" for an unsigned
    return _p - start == 2 && start[0] == '-' && start[1] == '0';
  }

  const char* _p;
  const char* const _end;
  const bool _admin;
  std::string _unescaped;
};
} // namespace

std::vector<ZEPAppFileError> ParseSettingsText(const std::string& iText, const std::string& iPath, bool iAdmin,
                                               ZEPAppSettingsDoc& oDoc) {
  oDoc = ZEPAppSettingsDoc();
  const std::size_t start = SkipSpace(iText, BomLength(iText));
  if (start == iText.size()) return {}; // a blank file is an empty one
  if (QuickReader(iText, iAdmin).Document(oDoc)) return {};
  return ParseSettingsTextThoroughly(iText, iPath, iAdmin, oDoc);
}

bool ReadSettingsValues(const std::string& iText, ZEPAppSettingsValues& oValues) {
  oValues = ZEPAppSettingsValues();
  const std::size_t start = SkipSpace(iText, BomLength(iText));
  if (start == iText.size()) return true; // a blank file is an empty one
  return QuickReader(iText, false).Document(oValues);
}

std::vector<ZEPAppFileError> ParseSettingsTextThoroughly(const std::string& iText, const std::string& iPath,
                                                         bool iAdmin, ZEPAppSettingsDoc& oDoc) {
  oDoc = ZEPAppSettingsDoc();
  std::vector<std::pair<std::size_t, std::string>> faults;
  const std::size_t start = SkipSpace(iText, BomLength(iText));
  if (start == iText.size()) return {}; // a blank file is an empty one

  const std::size_t bad = ZEPFirstBadUtf8(iText);
  if (bad != kNone) {
    char byte[8];
    std::snprintf(byte, sizeof byte, "0x%02X", static_cast<unsigned char>(iText[bad]));
    faults.emplace_back(bad, std::string("invalid UTF-8 (byte ") + byte + "); the file must be saved as UTF-8");
  } else if (std::size_t deep = TooDeep(iText); deep != kNone) {
    faults.emplace_back(deep, "nested more than " + std::to_string(kMaxDepth) + " levels deep");
  } else {
    json root;
    PlacedParser parser(root);
    if (!json::sax_parse(iText, &parser, json::input_format_t::json, true)) {
      faults.emplace_back(parser.Offset(), parser.Message());
    } else {
      ZEPAppSettingsDoc doc;
      Checker checker(Locate(iText), iAdmin);
      checker.Document(root, doc);
      faults = std::move(checker.Faults());
      oDoc = std::move(doc);
    }
  }

  std::stable_sort(faults.begin(), faults.end(),
                   [](const auto& a, const auto& b) { return a.first < b.first; });
  if (faults.size() > kMaxFaults) faults.resize(kMaxFaults);
  std::vector<ZEPAppFileError> errors;
  for (auto& [offset, message] : faults) {
    ZEPAppFileError e;
    e.path = iPath;
    LineAndColumn(iText, offset, e.line, e.column);
    e.message = std::move(message);
    errors.push_back(std::move(e));
  }
  return errors;
}

std::vector<ZEPAppFileError> PlaceMessages(const std::string& iText, const std::string& iPath,
                                           const std::vector<ZEPAppPlacedMessage>& iMessages) {
  std::vector<ZEPAppFileError> placed;
  if (iMessages.empty()) return placed;
  const Positions pos = Locate(iText); // one pass for all of them: only files with something to report
  for (const ZEPAppPlacedMessage& m : iMessages) {
    std::size_t offset = 0;
    const auto& where = m.atKey ? pos.keys : pos.values;
    if (auto it = where.find(m.pointer); it != where.end()) offset = it->second;
    ZEPAppFileError e;
    e.path = iPath;
    LineAndColumn(iText, offset, e.line, e.column);
    e.message = m.message;
    placed.push_back(std::move(e));
  }
  return placed;
}

std::string JsonPointer(const std::vector<std::string>& iKeys) {
  std::string pointer;
  for (const std::string& key : iKeys) pointer += "/" + EscapePointer(key);
  return pointer;
}

namespace {
// Writes the settings text directly, in the layout of nlohmann's dump(2) that the files have
// always had (two spaces per level, keys in the order of the maps, numbers as its serializer
// writes them), so that stored files keep their bytes. One pass, no search per key.
class SettingsWriter {
public:
  // iDepth: how deep what is written is nested (an attribute's object: 3).
  explicit SettingsWriter(std::string& oText, int iDepth = 0) : _out(oText), _depth(iDepth) {}

  void Open(char iBracket) { _out += iBracket; ++_depth; _first = true; }
  void Close(char iBracket) {
    --_depth;
    if (!_first) Newline();
    _out += iBracket;
    _first = false;
  }
  // Starts a member: "key": of the object open now.
  void Key(const std::string& iKey) {
    Next();
    String(iKey);
    _out += ": ";
  }
  // Starts an element of the array open now.
  void Element() { Next(); }
  // Runs of characters that need no escape are appended whole.
  void String(const std::string& iText) {
    _out += '"';
    std::size_t run = 0;
    for (std::size_t i = 0; i < iText.size(); ++i) {
      const unsigned char c = static_cast<unsigned char>(iText[i]);
      if (c >= 0x20 && c != '"' && c != '\\') continue;
      _out.append(iText, run, i - run);
      run = i + 1;
      switch (c) {
      case '"': _out += "\\\""; break;
      case '\\': _out += "\\\\"; break;
      case '\b': _out += "\\b"; break;
      case '\f': _out += "\\f"; break;
      case '\n': _out += "\\n"; break;
      case '\r': _out += "\\r"; break;
      case '\t': _out += "\\t"; break;
      default: {
        static const char kHex[] = "0123456789abcdef";
        _out += "\\u00";
        _out += kHex[c >> 4];
        _out += kHex[c & 15];
      }
      }
    }
    _out.append(iText, run, std::string::npos);
    _out += '"';
  }
  void Number(double iValue) {
    char buffer[64];
    _out.append(buffer, nlohmann::detail::to_chars(buffer, buffer + sizeof buffer, iValue));
  }
  void Number(const std::string& iText) { String(iText); } // a text among the values
  template <class Int> void Number(Int iValue) {
    char buffer[24];
    _out.append(buffer, std::to_chars(buffer, buffer + sizeof buffer, iValue).ptr);
  }
  void Bool(bool iValue) { _out += iValue ? "true" : "false"; }

private:
  void Next() {
    if (!_first) _out += ',';
    _first = false;
    Newline();
  }
  void Newline() {
    _out += '\n';
    _out.append(2 * static_cast<std::size_t>(_depth), ' ');
  }

  std::string& _out;
  int _depth;
  bool _first = true;
};

template <class T> const char* TypeName() {
  return std::is_same_v<T, double>         ? "double"
         : std::is_same_v<T, int>          ? "int"
         : std::is_same_v<T, unsigned int> ? "unsigned"
                                           : "text";
}

// Whether an attribute has something to write: a value, or (the administrator's file) a lock or
// its author.
bool Writes(const ZEPAppAttrEntry& iEntry, bool iAdmin) {
  return iEntry.value || (iAdmin && (iEntry.locked || !iEntry.by.empty()));
}

// Writes an attribute's object, "{" to "}".
void WriteEntry(SettingsWriter& w, const ZEPAppAttrEntry& iEntry, bool iAdmin) {
  w.Open('{');
  if (iEntry.value)
    std::visit(
        [&](const auto& values) {
          using T = typename std::decay_t<decltype(values)>::value_type;
          w.Key(TypeName<T>());
          if (values.size() == 1) return w.Number(values.front());
          w.Open('[');
          for (const T& v : values) {
            w.Element();
            w.Number(v);
          }
          w.Close(']');
        },
        *iEntry.value);
  if (iAdmin && iEntry.locked) {
    w.Key("locked");
    w.Bool(true);
  }
  if (iAdmin && !iEntry.by.empty()) {
    w.Key("by");
    w.String(iEntry.by);
  }
  w.Close('}');
}

// Text order of layout spans: sections, then repositories and attributes in map order.
bool Before(const ZEPAppEntrySpan& iSpan, const ZEPAppEntryRef& iRef) {
  if (iSpan.kind != iRef.kind) return iSpan.kind < iRef.kind;
  if (const int c = iSpan.repo->compare(iRef.repo); c != 0) return c < 0;
  return *iSpan.attr < iRef.attr;
}
} // namespace

bool FormatSettingsText(const ZEPAppSettingsDoc& iDoc, bool iAdmin, std::string& oText, std::string& oError,
                        ZEPAppTextLayout* oLayout) {
  std::string text;
  ZEPAppTextLayout layout;
  std::size_t attributes = 0;
  for (ZEPAppRepoKind kind : {ZEPAppRepoKind::Setting, ZEPAppRepoKind::Preference})
    for (const auto& repo : iDoc.Of(kind)) attributes += repo.second.size();
  text.reserve(64 + 96 * attributes);
  if (oLayout) layout.reserve(attributes);
  SettingsWriter w(text);
  w.Open('{');
  w.Key("format");
  w.Number(kSettingsFormat);
  for (ZEPAppRepoKind kind : {ZEPAppRepoKind::Setting, ZEPAppRepoKind::Preference}) {
    const char* section = kind == ZEPAppRepoKind::Setting ? "settings" : "preferences";
    w.Key(section);
    w.Open('{');
    for (const auto& [repo, entries] : iDoc.Of(kind)) {
      bool repoOpen = false; // a repository with nothing to write is left out
      const bool repoNameBad = ZEPFirstBadUtf8(repo) != kNone;
      for (const auto& [attr, entry] : entries) {
        if (repoNameBad || ZEPFirstBadUtf8(attr) != kNone || ZEPFirstBadUtf8(entry.by) != kNone) {
          oError = std::string(section) + "/" + repo + "/" + attr + " cannot be saved: its name is not valid UTF-8";
          return false;
        }
        if (entry.value)
          if (std::string why = Unstorable(*entry.value); !why.empty()) {
            oError = std::string(section) + "/" + repo + "/" + attr + " cannot be saved: " + why;
            return false;
          }
        if (!Writes(entry, iAdmin)) continue; // an attribute with nothing to write is left out
        if (!repoOpen) {
          w.Key(repo);
          w.Open('{');
          repoOpen = true;
        }
        w.Key(attr);
        const std::size_t begin = text.size();
        WriteEntry(w, entry, iAdmin);
        if (oLayout) layout.push_back({kind, &repo, &attr, begin, text.size()});
      }
      if (repoOpen) w.Close('}');
    }
    w.Close('}');
  }
  w.Close('}');
  text += '\n';
  oText = std::move(text);
  if (oLayout) *oLayout = std::move(layout);
  return true;
}

bool UpdateSettingsText(const std::string& iText, ZEPAppTextLayout& ioLayout,
                        const std::vector<ZEPAppEntryRef>& iChanged, bool iAdmin, std::string& oText) {
  if (iChanged.empty()) {
    oText = iText;
    return true;
  }
  // Each changed entry's new object, and the span it replaces.
  std::vector<std::pair<std::size_t, std::string>> pieces;
  pieces.reserve(iChanged.size());
  auto from = ioLayout.begin();
  for (const ZEPAppEntryRef& ref : iChanged) {
    if (!Writes(ref.entry, iAdmin) || (ref.entry.value && !Unstorable(*ref.entry.value).empty())) return false;
    // Changes come in text order, often one after another: the next span first, then a search.
    if (from == ioLayout.end() || from->attr != &ref.attr) from = std::lower_bound(from, ioLayout.end(), ref, Before);
    if (from == ioLayout.end() || from->kind != ref.kind || *from->repo != ref.repo || *from->attr != ref.attr)
      return false;
    std::string piece;
    SettingsWriter w(piece, 3);
    WriteEntry(w, ref.entry, iAdmin);
    pieces.emplace_back(static_cast<std::size_t>(from - ioLayout.begin()), std::move(piece));
    ++from;
  }
  // One copy of the text, the new objects in place of the old.
  std::size_t size = iText.size();
  for (const auto& [at, piece] : pieces) size = size - (ioLayout[at].end - ioLayout[at].begin) + piece.size();
  std::string text;
  text.reserve(size);
  std::size_t copied = 0;
  for (const auto& [at, piece] : pieces) {
    text.append(iText, copied, ioLayout[at].begin - copied);
    text += piece;
    copied = ioLayout[at].end;
  }
  text.append(iText, copied, std::string::npos);
  // The spans from the first change on move by what the pieces before them added or took.
  std::size_t shifted = 0; // modulo arithmetic: the text only grows or shrinks by what it is
  auto next = pieces.begin();
  for (std::size_t i = pieces.front().first; i < ioLayout.size(); ++i) {
    ZEPAppEntrySpan& span = ioLayout[i];
    std::size_t length = span.end - span.begin;
    span.begin += shifted;
    if (next != pieces.end() && next->first == i) {
      shifted += next->second.size() - length;
      length = next->second.size();
      ++next;
    }
    span.end = span.begin + length;
  }
  oText = std::move(text);
  return true;
}

} // namespace zepapp
