// What every page shares: foreign senders are ignored, locks beat the page's rules, radio
// groups show the stored value and write on change only.
#include "RecordingPages.h"

#include <algorithm>
#include <functional>
#include <map>

namespace {
struct PageCase {
  const char* name;
  std::function<ZEPDlgFrame*(HookScript&, ZEPDialog*)> open;
  std::vector<std::string> attributes; // from the page's table
  // User actions that write nothing with the module's hooks: push buttons, a radio already
  // on, the grid's scale range.
  int silent;
  // Hooks written beyond one per operated control: choosing a standard on the main page writes
  // its name and its flag.
  int extraWrites = 0;
  // Check texts the page reports when it is operated so (a second press while a dialog of the
  // newer framework is open).
  std::vector<std::string> reported = {};
};
void PrintTo(const PageCase& iCase, std::ostream* oStream) { *oStream << iCase.name; }


template <class P> ZEPDlgFrame* Opened(HookScript& iScript, ZEPDialog* iParent) {
  return OpenPage<P>(iScript, iParent);
}

std::vector<PageCase> Pages() {
  return {{"Grid", &Opened<RecordingGridPage>, kGridAttributes, 1},
          {"General", &Opened<RecordingGalPage>, kGalAttributes, 0},
          {"PrimaryView", &Opened<RecordingPrimaryViewPage>, kPrimaryViewAttributes, 0},
          {"Geometry", &Opened<RecordingGeoPage>, kGeoAttributes, 4},
          {"Dimension", &Opened<RecordingDimPage>, kDimAttributes, 1},
          {"Manipulators", &Opened<RecordingManipPage>, kManipAttributes, 0, 0},
          {"Administration", &Opened<RecordingAdminPage>, kAdminAttributes, 2, 0},
          {"Main", &Opened<RecordingMainPage>, kMainAttributes, 0, 1},
          {"Annotation",
           [](HookScript& s, ZEPDialog* p) {
             s.info.emplace("CalloutSizeOverrun", 1); // the larger of its two layouts
             return Opened<RecordingAnnotPage>(s, p);
           },
           kAnnotAttributes, 3, 0, {"!_pFraDialog"}},
          {"Display", &Opened<RecordingDisplayPage>, kDisplayAttributes, 3}};
}

void Collect(ZEPDialog* iWidget, std::vector<ZEPDialog*>& oAll) {
  oAll.push_back(iWidget);
  for (ZEPDialog* c : iWidget->GetChildren())
    Collect(c, oAll);
}

// Every widget of the page and of the sub-dialogs its push buttons open, as the user can.
std::vector<ZEPDialog*> CollectWithDialogs(ZEPDialog* iPage) {
  std::vector<ZEPDialog*> all;
  Collect(iPage, all);
  for (ZEPDialog* w : all)
    if (ZEPSysDynamicCast<ZEPDlgPushButton>(w)) ZEPDlgDriver::Click(w);
  all.clear();
  Collect(iPage, all);
  return all;
}

// Tries every user action on a widget; true when one was accepted.
bool Operate(ZEPDialog* w) {
  return ZEPDlgDriver::Click(w) || ZEPDlgDriver::Enter(w, 1.0) || ZEPDlgDriver::Select(w, 1) ||
         ZEPDlgDriver::EnterText(w, "x") || ZEPDlgDriver::SelectColor(w, 1, 2, 3);
}

class EveryPage : public ZEPHostTest, public ::testing::WithParamInterface<PageCase> {
protected:
  // The host has the drafting options open: pages read the paper length unit there.
  void SetUp() override {
    ZEPHostTest::SetUp();
    ZEPSysSettingRepository::Open("DraftingOptions");
  }
};
} // namespace

TEST_P(EveryPage, NotificationFromAWidgetThatIsNoControlChangesNothing) {
  HookScript script;
  script.allInfoSet = true; // every optional control exists
  for (const std::string& a : GetParam().attributes)
    script.values[a] = {1, 1, 1, 1, 1}; // dependants enabled
  ZEPDlgFrame* page = GetParam().open(script, &_root);
  const std::vector<ZEPDialog*> all = CollectWithDialogs(page);
  const std::string before = ZEPDlgDriver::Dump(page);
  auto* stranger = new ZEPDlgPushButton(&_root, "pushStranger");
  int delivered = 0;
  for (ZEPDialog* w : all) {
    // A combo's list opening and closing rebuilds its lines whoever says so, and writes
    // nothing: the close-up comes last, so that the screen ends as it was.
    std::vector<ZEPNotification*> notifs = w->GetNotifications();
    std::stable_partition(notifs.begin(), notifs.end(), [](ZEPNotification* n) {
      return !ZEPSysDynamicCast<ZEPDlgComboCloseUpNotification>(n);
    });
    for (ZEPNotification* n : notifs) {
      w->DeliverAs(n, stranger);
      w->DeliverAs(n, nullptr);
      w->DeliverAs(n, page);
      ++delivered;
    }
  }
  EXPECT_GT(delivered, 0);
  EXPECT_TRUE(script.calls.empty());
  EXPECT_EQ(ZEPDlgDriver::Dump(page), before);
}

TEST_P(EveryPage, LockedSettingsCannotBeChangedByAnyMeans) {
  HookScript script;
  script.allInfoSet = true;
  for (const std::string& a : GetParam().attributes) {
    script.locked.insert(a);
    script.values[a] = {1, 1, 1, 1, 1}; // flags on, so that page rules enable dependants
  }
  ZEPDlgFrame* page = GetParam().open(script, &_root);
  const std::vector<ZEPDialog*> all = CollectWithDialogs(page);
  int padlocks = 0;
  for (ZEPDialog* w : all) {
    auto* lock = ZEPSysDynamicCast<ZEPDlgLock>(w);
    if (!lock) continue;
    ++padlocks;
    EXPECT_TRUE(lock->IsLocked()) << lock->GetOwnName();
    for (ZEPDialog* sibling : w->GetParentDialog()->GetChildren()) {
      if (sibling == w) continue;
      EXPECT_FALSE(sibling->IsEffectivelyEnabled()) << sibling->GetOwnName();
      EXPECT_FALSE(Operate(sibling)) << sibling->GetOwnName();
    }
  }
  EXPECT_GT(padlocks, 3);
  EXPECT_TRUE(script.calls.empty());
}

TEST_P(EveryPage, ModuleHooksAcceptEveryChangeWithoutFailing) {
  HookScript script;
  ZEPDlgFrame* page = GetParam().open(script, &_root);
  const std::vector<ZEPDialog*> all = CollectWithDialogs(page);
  int operated = 0;
  for (ZEPDialog* w : all)
    operated += Operate(w) ? 1 : 0;
  EXPECT_GE(operated, 1);
  EXPECT_EQ(script.calls.size(),
            static_cast<size_t>(operated - GetParam().silent + GetParam().extraWrites))
      << "every operated control writes once, but for push buttons, a radio already on and the "
         "range combo";
  for (const ZEPCheckEntry& e : ZEPCheckLog::Entries())
    EXPECT_NE(std::find(GetParam().reported.begin(), GetParam().reported.end(), e.expression),
              GetParam().reported.end())
        << e.expression;
}

INSTANTIATE_TEST_SUITE_P(Pages, EveryPage, ::testing::ValuesIn(Pages()),
                         [](const ::testing::TestParamInfo<PageCase>& i) {
                           return std::string(i.param.name);
                         });

namespace {
// A radio group of a page: what it shows for each stored value, and what each radio writes.
struct RadioGroup {
  const char* page;
  std::map<std::string, std::vector<double>> values; // what keeps the group enabled
  const char* button;                                // opens the group's dialog; null on the page
  const char* attribute;
  std::vector<std::pair<const char*, double>> radios; // each radio and the value it writes
  std::vector<std::pair<double, const char*>> shown;  // stored value, the radio on ("" none)
};
void PrintTo(const RadioGroup& iGroup, std::ostream* oStream) { *oStream << iGroup.attribute; }

std::vector<RadioGroup> RadioGroups() {
  return {{"Dimension", {}, nullptr, "DimCreateCircle",
           {{"_radioDimCircleCenter", 0}, {"_radioDimCircleEdge", 1}},
           {{0, "_radioDimCircleCenter"}, {1, "_radioDimCircleEdge"}, {-1, "_radioDimCircleCenter"},
            {2, "_radioDimCircleCenter"}}},
          {"Dimension", {}, "pushAssoc3D", "DimAssoc3DMod",
           {{"_radioDimForce2DAlways", 2}, {"_radioDimForce2DWhenPb", 1}, {"_radioDimForce2DNever", 0}},
           {{2, "_radioDimForce2DAlways"}, {1, "_radioDimForce2DWhenPb"}, {0, "_radioDimForce2DNever"},
            {5, "_radioDimForce2DNever"}}},
          {"Geometry", {{"AllowGeomManip", {1}}}, "dragOptionPushButton", "DragSolveMode",
           {{"radioDragModeStd", 0}, {"radioDragModeMin", 1}, {"radioDragModeRel", 2}},
           {{0, "radioDragModeStd"}, {1, "radioDragModeMin"}, {2, "radioDragModeRel"}, {7, "radioDragModeStd"}}},
          {"Display", {{"BackgroundInViewFrame", {1}}}, nullptr, "BackgroundInViewFrameMode",
           {{"radBackgroundInViewFrameAuto", 1}, {"radBackgroundInViewFrameDemand", 2}},
           {{0, "radBackgroundInViewFrameAuto"}, {1, "radBackgroundInViewFrameAuto"},
            {2, "radBackgroundInViewFrameDemand"}, {7, "radBackgroundInViewFrameAuto"}}},
          {"Display", {}, nullptr, "CappingBackground",
           {{"radCappingColorFix", 0}, {"radCappingColorFromFace", 1}},
           {{0, "radCappingColorFix"}, {1, "radCappingColorFromFace"}, {2, "radCappingColorFix"},
            {7, "radCappingColorFix"}}},
          {"Display", {}, nullptr, "CappingPattern",
           {{"radCappingPatternNone", 0}, {"radCappingPatternMaterial", 1}},
           {{0, "radCappingPatternNone"}, {1, "radCappingPatternMaterial"}, {2, "radCappingPatternNone"},
            {7, "radCappingPatternNone"}}},
          {"Annotation", {}, nullptr, "AreaFillOptimizationMode",
           {{"radOptimGenAndGeo", 0}, {"radOptimImport", 1}},
           {{0, "radOptimGenAndGeo"}, {1, "radOptimImport"}, {2, ""}}},
          {"Administration", {{"ViewNamesUnicity", {1}}}, nullptr, "ViewNameUnicityScope",
           {{"radViewNameUnicityInSheet", 0}, {"radViewNameUnicityInLayout", 1}},
           {{0, "radViewNameUnicityInSheet"}, {1, "radViewNameUnicityInLayout"}, {5, "radViewNameUnicityInLayout"}}},
          {"Administration", {}, nullptr, "SelectionOnCurrentAssembly",
           {{"radElemUnderCurAssemblyRoot", 0}, {"radElemUnderCurFavContextRoot", 1}, {"radAnyRelevantElement", 2}},
           {{0, "radElemUnderCurAssemblyRoot"}, {2, "radAnyRelevantElement"}, {7, ""}}},
          {"Administration", {}, nullptr, "EnggConLocation",
           {{"radSelectedAssGeom", 0}, {"radSelectedAssGeomWithAnnotation", 1}},
           {{0, "radSelectedAssGeom"}, {1, "radSelectedAssGeomWithAnnotation"}}}};
}

class EveryRadioGroup : public ZEPHostTest, public ::testing::WithParamInterface<RadioGroup> {
protected:
  void SetUp() override {
    ZEPHostTest::SetUp();
    ZEPSysSettingRepository::Open("DraftingOptions");
  }
};
} // namespace

// For each stored value: the radio it shows alone is on; clicking it writes nothing, each other
// radio writes its value once however often it is clicked, and coming back writes the shown one.
TEST_P(EveryRadioGroup, ShowsTheStoredValueAndWritesOnChangeOnly) {
  const RadioGroup& group = GetParam();
  const std::vector<PageCase> pages = Pages();
  const auto page = std::find_if(pages.begin(), pages.end(),
                                 [&](const PageCase& p) { return std::string(p.name) == group.page; });
  ASSERT_NE(page, pages.end());
  for (const auto& [stored, shown] : group.shown) {
    SCOPED_TRACE("stored " + std::to_string(stored));
    HookScript script;
    script.allInfoSet = true; // every optional control exists
    script.values = group.values;
    script.values[group.attribute] = {stored};
    auto* window = new ZEPDlgWindow(&_root, "window", 0);
    ZEPDlgFrame* frame = page->open(script, window);
    if (group.button) {
      ASSERT_TRUE(ZEPDlgDriver::Click(ZEPDlgDriver::FindControl(frame, group.button)));
    }
    auto radio = [&](const char* iName) {
      auto* found = ZEPSysDynamicCast<ZEPDlgRadioButton>(ZEPDlgDriver::FindControl(frame, iName));
      EXPECT_NE(found, nullptr) << iName;
      return found;
    };
    std::vector<double> expected;
    double back = 0;
    for (const auto& [name, value] : group.radios) {
      ZEPDlgRadioButton* r = radio(name);
      ASSERT_NE(r, nullptr);
      const bool on = std::string(name) == shown;
      EXPECT_EQ(r->GetState() == ZEPDlgChecked, on) << name;
      if (on) back = value;
      else expected.push_back(value);
    }
    EXPECT_TRUE(script.calls.empty());
    if (*shown) {
      ASSERT_TRUE(ZEPDlgDriver::Click(radio(shown)));
    }
    for (const auto& [name, value] : group.radios) {
      if (std::string(name) == shown) continue;
      for (int twice = 0; twice < 2; ++twice) {
        ASSERT_TRUE(ZEPDlgDriver::Click(radio(name))) << name;
      }
    }
    if (*shown) {
      ASSERT_TRUE(ZEPDlgDriver::Click(radio(shown)));
      expected.push_back(back);
    }
    std::vector<double> written;
    for (const HookCall& call : script.calls) {
      EXPECT_EQ(call.hook, std::string("SetSys") + group.attribute);
      written.push_back(call.values.at(0));
    }
    EXPECT_EQ(written, expected);
    delete window;
    ZEPDlgDriver::Idle();
  }
}

INSTANTIATE_TEST_SUITE_P(Groups, EveryRadioGroup, ::testing::ValuesIn(RadioGroups()),
                         [](const ::testing::TestParamInfo<RadioGroup>& i) {
                           return std::string(i.param.attribute);
                         });
