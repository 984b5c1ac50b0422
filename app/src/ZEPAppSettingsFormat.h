// The JSON form of the settings files, read with the position of every fault.
//
//   {
//     "format": 1,
//     "settings": {
//       "DraftingOptions": {
//         "DrwPaperLengthUnit": {"int": 1},
//         "Drw_GridSpacing": {"double": [10.0, 20.0, 30.0, 40.0, 50.0]},
//         "Drw_GridColor": {"unsigned": [255, 0, 0], "locked": true, "by": "cad-admin"},
//         "DrwStandards": {"text": ["ISO", "ANSI"]},
//         "DrwFolder": {"text": "Folder"}
//       }
//     },
//     "preferences": {
//       "DraftingOptions": {"dlgPropTbBehaviorX": {"int": 120}}
//     }
//   }
//
// Each attribute holds exactly one of "double", "int", "unsigned" or "text": an array, or a
// scalar for a single value (so a list of one text reads back as one text: to the program both
// are a list of texts). A list may be empty. Only the administrator's file may add "locked" (a
// default is not a lock) and "by", who locked it. "format" may be left out; anything else
// unknown is a fault rather than something silently dropped at the next save.
#pragma once

#include "ZEPSettings.h"

#include <map>
#include <optional>
#include <string>
#include <vector>

namespace zepapp {

using ZEPAppValue = ZEPSysSettingRepository::Value;

enum class ZEPAppRepoKind { Setting, Preference };

struct ZEPAppAttrEntry {
  std::optional<ZEPAppValue> value;
  bool locked = false;
  std::string by; // who locked it
  bool operator==(const ZEPAppAttrEntry& o) const {
    return value == o.value && locked == o.locked && by == o.by;
  }
};

// Attribute name -> entry.
using ZEPAppRepoEntries = std::map<std::string, ZEPAppAttrEntry>;

// What a settings file holds for each kind of repository: repositories by name.
template <class Repo> struct ZEPAppSections {
  std::map<std::string, Repo> settings;
  std::map<std::string, Repo> preferences;
  std::map<std::string, Repo>& Of(ZEPAppRepoKind iKind) {
    return iKind == ZEPAppRepoKind::Setting ? settings : preferences;
  }
  const std::map<std::string, Repo>& Of(ZEPAppRepoKind iKind) const {
    return iKind == ZEPAppRepoKind::Setting ? settings : preferences;
  }
};

// The content of one settings file.
using ZEPAppSettingsDoc = ZEPAppSections<ZEPAppRepoEntries>;

// A fault of a settings file. line and column are 1-based (columns count characters); 0 when
// the fault has no place in the text (an unreadable file).
struct ZEPAppFileError {
  std::string path;
  int line = 0;
  int column = 0;
  std::string message;
  // The file could not be read at all (not opened, not a regular file, too large), rather
  // than read and found faulty.
  bool unreadable = false;
  // "path:line:column: message", the form editors jump to.
  std::string Text() const;
};

inline constexpr int kSettingsFormat = 1;

// Reads iText, the content of iPath. Blank text is an empty file. Answers the faults in text
// order; at most a few dozen are kept. oDoc holds what could be read: everything when there is
// no fault, the well-formed entries when the faults are of the format only (an entry with a
// fault may lack its value but keeps its lock), nothing after a syntax error.
std::vector<ZEPAppFileError> ParseSettingsText(const std::string& iText, const std::string& iPath,
                                               bool iAdmin, ZEPAppSettingsDoc& oDoc);

// The same answers as ParseSettingsText, from the pass that checks and places everything
// (ParseSettingsText takes a quicker road for a file with nothing to report and comes here
// otherwise). For tests that hold the two roads to the same answers.
std::vector<ZEPAppFileError> ParseSettingsTextThoroughly(const std::string& iText, const std::string& iPath,
                                                         bool iAdmin, ZEPAppSettingsDoc& oDoc);

// The values of a user's file (which holds no locks), repositories by name: what loading it
// gives the repositories.
using ZEPAppRepoValues = std::map<std::string, ZEPAppValue>;
using ZEPAppSettingsValues = ZEPAppSections<ZEPAppRepoValues>;

// Reads the values of a user's file in one pass, without a document. True when iText is a
// sound user's file (ParseSettingsText would report nothing and read the same values); false
// when it holds something to report or a rare form left to ParseSettingsText, which then
// tells. oValues is complete only on true.
bool ReadSettingsValues(const std::string& iText, ZEPAppSettingsValues& oValues);

// Where one attribute's object ("{...}", after its key) lies in a text FormatSettingsText wrote.
// repo and attr point at the keys of the document's maps.
struct ZEPAppEntrySpan {
  ZEPAppRepoKind kind;
  const std::string* repo;
  const std::string* attr;
  std::size_t begin, end;
};
// The spans of every attribute written, in text order (the order of the document's maps).
using ZEPAppTextLayout = std::vector<ZEPAppEntrySpan>;

// Writes iDoc in the form above. False with oError when something cannot be written faithfully
// (a NaN or infinity, a name or text that is not UTF-8, a text holding a NUL); iAdmin keeps
// locks, else they are left out. oLayout, when given, receives where each attribute was written.
bool FormatSettingsText(const ZEPAppSettingsDoc& iDoc, bool iAdmin, std::string& oText, std::string& oError,
                        ZEPAppTextLayout* oLayout = nullptr);

// An attribute of a document, named the way a layout names it.
struct ZEPAppEntryRef {
  ZEPAppRepoKind kind;
  const std::string& repo;
  const std::string& attr;
  const ZEPAppAttrEntry& entry;
};
// The text FormatSettingsText writes for a document, from iText, written from it with ioLayout,
// after the entries iChanged (in text order) of that same document changed in place: only
// those entries are written again, so the cost is a copy of the text rather than a formatting
// of every value. oText receives the text, and ioLayout is moved to where the entries now lie.
// False, with both left as they were, when an entry cannot be rewritten where it is (not in the
// layout, nothing left to write for it, or a value that cannot be written): format the whole
// document then, which tells what is wrong, if anything.
bool UpdateSettingsText(const std::string& iText, ZEPAppTextLayout& ioLayout,
                        const std::vector<ZEPAppEntryRef>& iChanged, bool iAdmin, std::string& oText);

// A message about one place of a file that parsed, named by a JSON pointer
// ("/settings/DraftingOptions/DrwViewAxisLength/double"); atKey: the member's key rather than
// its value.
struct ZEPAppPlacedMessage {
  std::string pointer;
  bool atKey = false;
  std::string message;
};
// The messages with the line and column of their places (the start of the text for a place
// that is not found), in the order given.
std::vector<ZEPAppFileError> PlaceMessages(const std::string& iText, const std::string& iPath,
                                           const std::vector<ZEPAppPlacedMessage>& iMessages);
// The JSON pointer of nested keys.
std::string JsonPointer(const std::vector<std::string>& iKeys);

// Line and column (1-based, characters) of a byte offset of iText.
void LineAndColumn(const std::string& iText, std::size_t iOffset, int& oLine, int& oColumn);

// Whether every double of iValue is finite; oIndex tells the first that is not.
bool IsFinite(const ZEPAppValue& iValue, std::size_t* oIndex = nullptr);
// Why iValue cannot be written to a file (a NaN or infinity, a text that is not UTF-8 or holds
// a NUL, which no JSON text of ours carries); empty when it can.
std::string Unstorable(const ZEPAppValue& iValue);

} // namespace zepapp
