// The index the application's hooks reach their settings by, generated from ZEPAppSettings.def.
#include "ZEPAppBinding.h"

#include <gtest/gtest.h>

using namespace zepapp;

TEST(AppBinding, EveryRowIsReachedByItsPageAndName) {
  const std::vector<ZEPAppSetting>& rows = AppSettings();
  ASSERT_EQ(rows.size(), static_cast<std::size_t>(kAppSettingCount));
  for (std::size_t r = 0; r < rows.size(); ++r) {
    SCOPED_TRACE(rows[r].page + "/" + rows[r].attribute);
    EXPECT_EQ(rows[r].page, kAppSettingKeys[r].page);
    EXPECT_EQ(rows[r].attribute, kAppSettingKeys[r].attribute);
    // Through the chain of rows sharing the attribute's name, whatever page comes first.
    EXPECT_EQ(&rows[r], FindSetting(rows[r].page, rows[r].attribute));
  }
  EXPECT_EQ(nullptr, FindSetting("Grid", "NoSuchAttribute"));
  EXPECT_EQ(nullptr, FindSetting("NoSuchPage", rows.front().attribute));
}

// Texts go through the repository exactly (UTF-8 included); without a stored text the table's
// default shows; what a repository cannot keep is refused and changes nothing.
TEST(AppBinding, TextsAndTextListsRoundTripExactly) {
  ZEPSysSettingRepository::CloseAll();
  ZEPSysSettingRepository* rep = ZEPSysSettingRepository::Open("DraftingOptions");
  ZEPAppBinding main("Main");
  const int nameRow = FirstSettingRow("StandardName"), keysRow = FirstSettingRow("StandardPLMIDList");
  ZEPUnicodeString name;
  ZEPListValZEPUnicodeString keys;
  keys.Append("left from before");
  ASSERT_EQ(main.Get(nameRow, name), S_OK);
  EXPECT_EQ(name.str(), FindSetting("Main", "StandardName")->texts.at(0));
  ASSERT_EQ(main.Get(keysRow, keys), S_OK);
  EXPECT_EQ(keys.Size(), 0); // an empty list by default

  const ZEPUnicodeString utf8("Norme soci\xC3\xA9t\xC3\xA9 \xE2\x80\x93 \xE6\xA8\x99\xE6\xBA\x96");
  ASSERT_EQ(main.Set(nameRow, utf8), S_OK);
  ZEPListValZEPUnicodeString written;
  for (const char* key : {"K-2", "", "K-1 \xC3\xA9"}) written.Append(key);
  ASSERT_EQ(main.Set(keysRow, written), S_OK);
  ASSERT_EQ(main.Get(nameRow, name), S_OK);
  ASSERT_EQ(main.Get(keysRow, keys), S_OK);
  EXPECT_EQ(name, utf8);
  EXPECT_EQ(keys.Items(), written.Items());

  EXPECT_EQ(main.Set(nameRow, ZEPUnicodeString("bad \xC3")), E_FAIL);
  ASSERT_EQ(main.Get(nameRow, name), S_OK);
  EXPECT_EQ(name, utf8);
  rep->SetLock("DrwStandardPLMIDList", true);
  EXPECT_EQ(main.Set(keysRow, ZEPListValZEPUnicodeString()), E_FAIL);
  ZEPSysSettingRepository::CloseAll();
}
