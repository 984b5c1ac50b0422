// The text of the settings files: saved files keep the bytes they have always had, and the
// quick reading of a sound file answers what the thorough, fault-placing reading answers.
#include "TestSupport.h"
#include "ZEPAppSettingsFormat.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <algorithm>
#include <cfloat>
#include <climits>
#include <cmath>
#include <fstream>
#include <iterator>
#include <random>
#include <tuple>

using namespace zepapp;

namespace {

// How the files were written before the direct writer: nlohmann's ordered document, dumped
// with two spaces. Kept here as the reference the bytes are held to.
std::string WrittenAsBefore(const ZEPAppSettingsDoc& iDoc, bool iAdmin) {
  using ojson = nlohmann::ordered_json;
  ojson root = ojson::object();
  root["format"] = kSettingsFormat;
  for (ZEPAppRepoKind kind : {ZEPAppRepoKind::Setting, ZEPAppRepoKind::Preference}) {
    ojson& out = root[kind == ZEPAppRepoKind::Setting ? "settings" : "preferences"] = ojson::object();
    for (const auto& [repo, entries] : iDoc.Of(kind)) {
      ojson attrs = ojson::object();
      for (const auto& [attr, entry] : entries) {
        ojson e = ojson::object();
        if (entry.value)
          std::visit(
              [&](const auto& values) {
                using T = typename std::decay_t<decltype(values)>::value_type;
                const char* type = std::is_same_v<T, double>         ? "double"
                                   : std::is_same_v<T, int>          ? "int"
                                   : std::is_same_v<T, unsigned int> ? "unsigned"
                                                                     : "text";
                e[type] = values.size() == 1 ? ojson(values.front()) : ojson(values);
              },
              *entry.value);
        if (iAdmin && entry.locked) e["locked"] = true;
        if (iAdmin && !entry.by.empty()) e["by"] = entry.by;
        if (!e.empty()) attrs[attr] = std::move(e);
      }
      if (!attrs.empty()) out[repo] = std::move(attrs);
    }
  }
  return root.dump(2) + "\n";
}

// Documents with awkward names and numbers: escapes, control characters, non-ASCII, negative
// zero, subnormals, the extremes of each kind, empty and single-value arrays, bare locks.
ZEPAppSettingsDoc RandomDoc(std::mt19937& ioRandom) {
  static const std::vector<std::string> names = {
      "Drw_GridSpacing", "a/b~c", "quote\"d", "back\\slash", "tab\there", "nl\nx", "\x01\x1f\x7f", "Ma\xC3\x9F",
      "\xE6\x97\xA5\xE6\x9C\xAC", "\xF0\x9F\x93\x90", "z", "A", "0", " "};
  static const std::vector<double> doubles = {0.0,     -0.0,    1.0,     0.1,     1.0 / 3,       100.0,    1e6,
                                              1e15,    1e16,    1e17,    1e-4,    1e-5,          1e308,    -1e-300,
                                              5e-324,  DBL_MAX, DBL_MIN, 2.5e-3,  123456789.125, -42.0,    0.3};
  auto pick = [&](std::size_t n) { return static_cast<std::size_t>(ioRandom() % n); };
  ZEPAppSettingsDoc doc;
  for (ZEPAppRepoKind kind : {ZEPAppRepoKind::Setting, ZEPAppRepoKind::Preference})
    for (std::size_t r = pick(3); r > 0; --r) {
      ZEPAppRepoEntries& entries = doc.Of(kind)[names[pick(names.size())]];
      for (std::size_t a = pick(6); a > 0; --a) {
        ZEPAppAttrEntry& e = entries[names[pick(names.size())] + std::to_string(pick(3))];
        const std::size_t count = pick(7);
        switch (pick(5)) {
        case 0: {
          std::vector<double> v;
          for (std::size_t k = 0; k < count; ++k) {
            double d = doubles[pick(doubles.size())];
            if (pick(3) == 0) { // any finite bit pattern
              std::uint64_t bits = (std::uint64_t(ioRandom()) << 32) | ioRandom();
              std::memcpy(&d, &bits, sizeof d);
              if (!std::isfinite(d)) d = 7.0;
            }
            v.push_back(d);
          }
          e.value = v;
          break;
        }
        case 1: {
          std::vector<int> v;
          for (std::size_t k = 0; k < count; ++k)
            v.push_back(std::vector<int>{0, -1, 7, INT_MIN, INT_MAX}[pick(5)] ^ static_cast<int>(pick(2)));
          e.value = v;
          break;
        }
        case 2: e.value = std::vector<unsigned int>(count, pick(2) ? UINT_MAX : static_cast<unsigned>(ioRandom()));
          break;
        case 3: { // texts, with the names' escapes and characters
          std::vector<std::string> v;
          for (std::size_t k = 0; k < count; ++k) v.push_back(names[pick(names.size())] + (pick(2) ? "" : "\x1b\\"));
          e.value = v;
          break;
        }
        default: break; // no value: a bare lock, or nothing to write
        }
        e.locked = pick(2) == 0;
        if (e.locked && pick(2) == 0) e.by = names[pick(names.size())]; // as locks are recorded
      }
    }
  return doc;
}

bool SameDoc(const ZEPAppSettingsDoc& a, const ZEPAppSettingsDoc& b) {
  return a.settings == b.settings && a.preferences == b.preferences;
}

// Both readings of iText, compared: the same faults at the same places, the same content.
void ExpectSameReading(const std::string& iText, bool iAdmin) {
  ZEPAppSettingsDoc quick, thorough;
  const std::vector<ZEPAppFileError> q = ParseSettingsText(iText, "f.json", iAdmin, quick);
  const std::vector<ZEPAppFileError> t = ParseSettingsTextThoroughly(iText, "f.json", iAdmin, thorough);
  ASSERT_EQ(t.size(), q.size()) << iText;
  for (std::size_t k = 0; k < q.size(); ++k) EXPECT_EQ(t[k].Text(), q[k].Text()) << iText;
  EXPECT_TRUE(SameDoc(thorough, quick)) << iText;
}

} // namespace

TEST(SettingsText, SavedBytesAreThoseWrittenBefore) {
  std::mt19937 random(1406u);
  for (int round = 0; round < 300; ++round) {
    const ZEPAppSettingsDoc doc = RandomDoc(random);
    for (bool admin : {false, true}) {
      std::string text, err;
      ASSERT_TRUE(FormatSettingsText(doc, admin, text, err)) << err;
      ASSERT_EQ(WrittenAsBefore(doc, admin), text);
    }
  }
  // The bytes of a typical file, pinned apart from any library's version.
  ZEPAppSettingsDoc doc;
  doc.settings["DraftingOptions"]["DrwPaperLengthUnit"].value = std::vector<int>{1};
  doc.settings["DraftingOptions"]["DrwViewAxisLength"] = {std::vector<double>{50.0}, true, "cad-admin"};
  doc.settings["DrwSketcherSpecific"]["Drw_settings_GridPrimarySpacing"].value =
      std::vector<double>{100.0, 10000.0, 1e6, 1.0, 0.01};
  doc.settings["DrwSketcherSpecific"]["Drw_GridColor"].value = std::vector<unsigned>{255, 0, 0};
  doc.settings["Empty"]["Nothing"] = {};
  doc.preferences["DraftingOptions"]["dlgPropTbBehaviorX"].value = std::vector<int>{-120};
  doc.settings["DraftingOptions"]["DrwFolder"].value = std::vector<std::string>{"C:\\Dr\xC3\xA4wings \"A\"\n"};
  doc.settings["DraftingOptions"]["DrwStandards"].value = std::vector<std::string>{"ISO", "\xE6\x97\xA5\x01"};
  doc.settings["DraftingOptions"]["DrwNoStandards"] = {std::vector<std::string>{}, true, ""};
  std::string text, err;
  ASSERT_TRUE(FormatSettingsText(doc, true, text, err)) << err;
  const std::string golden = std::string(ZEP_GOLDEN_DIR) + "/settings_saved.json";
  std::ifstream in(golden, std::ios::binary);
  if (std::string(std::istreambuf_iterator<char>(in), {}) != text) {
    std::ofstream(golden + ".new", std::ios::binary) << text;
    ADD_FAILURE() << "the saved bytes changed; see " << golden << ".new";
  }
}

TEST(SettingsText, QuickReadingAnswersAsTheThoroughOne) {
  // What the program writes reads back whole, by either road.
  std::mt19937 random(2024u);
  std::vector<std::string> samples;
  for (int round = 0; round < 200; ++round) {
    const ZEPAppSettingsDoc doc = RandomDoc(random);
    for (bool admin : {false, true}) {
      std::string text, err;
      ASSERT_TRUE(FormatSettingsText(doc, admin, text, err)) << err;
      ZEPAppSettingsDoc read;
      ASSERT_TRUE(ParseSettingsText(text, "f.json", admin, read).empty()) << text;
      ZEPAppSettingsDoc written;
      ASSERT_TRUE(ParseSettingsTextThoroughly(text, "f.json", admin, written).empty()) << text;
      EXPECT_TRUE(SameDoc(written, read)) << text;
      if (round < 20) samples.push_back(text);
    }
  }

  // Forms a writer never produces but a person may: each either read alike or refused alike.
  const std::string head = "{\"settings\": {\"R\": {";
  for (const std::string& body : std::vector<std::string>{
           "\"A\": {\"double\": 1}", "\"A\": {\"double\": -0}", "\"A\": {\"double\": 18446744073709551616}",
           "\"A\": {\"double\": -9223372036854775809}", "\"A\": {\"double\": 1e-400}", "\"A\": {\"double\": 1E+2}",
           "\"A\": {\"double\": 01}", "\"A\": {\"double\": 1.}", "\"A\": {\"double\": .5}", "\"A\": {\"double\": +1}",
           "\"A\": {\"double\": 1e}", "\"A\": {\"double\": -}", "\"A\": {\"double\": []}", "\"A\": {\"double\": [1,]}",
           "\"A\": {\"double\": [[1]]}", "\"A\": {\"int\": -0}", "\"A\": {\"unsigned\": -0}", "\"A\": {\"int\": 1e2}",
           "\"A\": {\"int\": 2147483647}", "\"A\": {\"int\": -2147483649}", "\"A\": {\"unsigned\": 4294967295}",
           "\"A\": {\"unsigned\": 1.0}", "\"A\": {\"int\": 1, \"int\": 2}", "\"A\": {\"locked\": true}",
           "\"A\": {\"locked\": true, \"locked\": false, \"int\": 1}", "\"A\": {\"by\": \"x\", \"int\": 1}",
           "\"A\": {\"locked\": truex, \"int\": 1}", "\"A\": {\"int\": 1}, \"A\": {\"int\": 1}",
           "\"B\": {\"int\": 1}, \"A\": {\"int\": 2}", "\"\\u0041\": {\"int\": 1}", "\"\\/\\b\": {\"int\": 1}",
           "\"\\x\": {\"int\": 1}", "\"\": {\"int\": 1}", "\"A\": {}", "\"A\": 1", "\"A\": {\"Int\": 1}",
           "\"\t\": {\"int\": 1}", "\"\xC3\": {\"int\": 1}", "\"\xC3\x9F\": {\"int\": 1}",
           "\"A\": {\"text\": \"x\"}", "\"A\": {\"text\": []}", "\"A\": {\"text\": [\"\", \"\\\"\\\\\\n\"]}",
           "\"A\": {\"text\": \"\\u00e9\"}", "\"A\": {\"text\": \"\\u0000\"}", "\"A\": {\"text\": \"\\ud800\"}",
           "\"A\": {\"text\": [\"a\", 1]}", "\"A\": {\"text\": null}", "\"A\": {\"text\": [[\"a\"]]}",
           "\"A\": {\"text\": \"a\", \"int\": 1}", "\"A\": {\"int\": 1, \"text\": \"a\"}",
           "\"A\": {\"text\": \"\t\"}", "\"A\": {\"text\": \"\xC3\"}", "\"A\": {\"Text\": \"a\"}"})
    for (bool admin : {false, true}) {
      SCOPED_TRACE(body);
      ExpectSameReading(head + body + "}}}", admin);
    }
  for (const std::string& text :
       {std::string("\xEF\xBB\xBF{}"), std::string("{}x"), std::string("{\"format\": 1, \"format\": 1}"),
        std::string("{\"format\": 1.0}"), std::string("{\"settings\": {}, \"settings\": {}}"),
        std::string("{\"settings\": {\"R\": {}}, \"preferences\": {\"R\": {}}}"), std::string("[]"),
        std::string("{\"settings\": {\"\": {}}}"), std::string(" \r\n\t{ } \n"), std::string("{,}")})
    for (bool admin : {false, true}) ExpectSameReading(text, admin);

  // Written files with a few characters changed, inserted or removed.
  const char alphabet[] = "{}[]\",:0-.eE1+\\/u tfn\x80\xC3\xFF";
  for (int round = 0; round < 3000; ++round) {
    const std::string text = Garbled(samples[random() % samples.size()], random, alphabet, 2);
    ExpectSameReading(text, round % 2 == 0);
    if (HasFailure()) return;
  }
}

TEST(SettingsText, EntriesRewrittenInPlaceGiveTheWholeTextWrittenAgain) {
  std::mt19937 random(77u);
  auto spans = [](const ZEPAppTextLayout& l) {
    std::vector<std::tuple<ZEPAppRepoKind, std::string, std::string, std::size_t, std::size_t>> out;
    for (const ZEPAppEntrySpan& s : l) out.emplace_back(s.kind, *s.repo, *s.attr, s.begin, s.end);
    return out;
  };
  int updated = 0, refused = 0;
  for (int round = 0; round < 300; ++round) {
    ZEPAppSettingsDoc doc = RandomDoc(random);
    const ZEPAppSettingsDoc other = RandomDoc(random); // where new values come from
    std::vector<const ZEPAppAttrEntry*> pool;
    for (const auto* repos : {&other.settings, &other.preferences})
      for (const auto& [repo, entries] : *repos)
        for (const auto& [attr, entry] : entries) pool.push_back(&entry);
    const bool admin = round % 2 == 0;
    std::string text, err;
    ZEPAppTextLayout layout;
    ASSERT_TRUE(FormatSettingsText(doc, admin, text, err, &layout)) << err;
    // Some written entries take another entry's value, kind, count and lock.
    std::vector<ZEPAppEntryRef> changed;
    bool writable = true;
    for (ZEPAppRepoKind kind : {ZEPAppRepoKind::Setting, ZEPAppRepoKind::Preference})
      for (auto& [repo, entries] : doc.Of(kind))
        for (auto& [attr, entry] : entries) {
          const bool written =
              std::any_of(layout.begin(), layout.end(), [&](const ZEPAppEntrySpan& s) { return s.attr == &attr; });
          if (!written || pool.empty() || random() % 3 != 0) continue;
          entry = *pool[random() % pool.size()];
          if (random() % 25 == 0) entry.value = std::vector<double>{NAN};
          writable = writable && (entry.value || (admin && (entry.locked || !entry.by.empty()))) &&
                     !(entry.value && !Unstorable(*entry.value).empty());
          changed.push_back({kind, repo, attr, entry});
        }
    const std::string before = text;
    const auto layoutBefore = spans(layout);
    std::string next;
    const bool done = UpdateSettingsText(text, layout, changed, admin, next);
    ASSERT_EQ(writable, done);
    if (!done) { // nothing moved: the whole document is formatted instead
      ++refused;
      EXPECT_EQ(layoutBefore, spans(layout));
      continue;
    }
    ++updated;
    std::string whole;
    ZEPAppTextLayout wholeLayout;
    ASSERT_TRUE(FormatSettingsText(doc, admin, whole, err, &wholeLayout)) << err;
    ASSERT_EQ(whole, next);
    ASSERT_EQ(spans(wholeLayout), spans(layout));
    EXPECT_EQ(before, text);
  }
  EXPECT_GT(updated, 100);
  EXPECT_GT(refused, 5);
  // An attribute the text does not hold is not guessed at.
  ZEPAppSettingsDoc doc;
  doc.settings["R"]["A"].value = std::vector<int>{1};
  std::string text, err, next;
  ZEPAppTextLayout layout;
  ASSERT_TRUE(FormatSettingsText(doc, false, text, err, &layout));
  ZEPAppAttrEntry& added = doc.settings["R"]["B"];
  added.value = std::vector<int>{2};
  EXPECT_FALSE(UpdateSettingsText(text, layout, {{ZEPAppRepoKind::Setting, "R", "B", added}}, false, next));
  EXPECT_FALSE(UpdateSettingsText(text, layout, {{ZEPAppRepoKind::Preference, "R", "A", added}}, false, next));
}
