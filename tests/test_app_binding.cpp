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
