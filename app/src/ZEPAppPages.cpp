#include "ZEPAppPages.h"

#include "ZEP2DBaseOptDimFrm.h"
#include "ZEP2DBaseOptAdminFrm.h"
#include "ZEP2DBaseOptAnnotFrm.h"
#include "ZEP2DBaseOptDisplayFrm.h"
#include "ZEP2DBaseOptGalFrm.h"
#include "ZEP2DBaseOptGeoFrm.h"
#include "ZEP2DBaseOptGridFrm.h"
#include "ZEP2DBaseOptMainFrm.h"
#include "ZEP2DBaseOptManipFrm.h"
#include "ZEP2DBasePrimaryViewFrm.h"

#include <algorithm>
#include <set>
#include <variant>

namespace zepapp {
namespace {
// Each page: a subclass whose hooks are bound through its table.
class GridPage : public ZEP2DBaseOptGridFrm {
public:
  explicit GridPage(ZEPDialog* iParent) : ZEP2DBaseOptGridFrm(iParent, "GridPage") {}

protected:
#define ZEP_SETTING(Name, Kind) ZEP_APP_BIND_SETTING_HOOKS(Name, Kind)
#include "ZEP2DBaseOptGridFrm.def"
#undef ZEP_SETTING

private:
  ZEPAppBinding _binding{"Grid"};
};

class GeneralPage : public ZEP2DBaseOptGalFrm {
public:
  explicit GeneralPage(ZEPDialog* iParent) : ZEP2DBaseOptGalFrm(iParent, "GeneralPage") {}

protected:
#define ZEP_SETTING(Name, Kind) ZEP_APP_BIND_SETTING_HOOKS(Name, Kind)
#include "ZEP2DBaseOptGalFrm.def"
#undef ZEP_SETTING

private:
  ZEPAppBinding _binding{"General"};
};

class PrimaryViewPage : public ZEP2DBasePrimaryViewFrm {
public:
  explicit PrimaryViewPage(ZEPDialog* iParent) : ZEP2DBasePrimaryViewFrm(iParent) {}

protected:
#define ZEP_SETTING(Name, Kind) ZEP_APP_BIND_SETTING_HOOKS(Name, Kind)
#include "ZEP2DBasePrimaryViewFrm.def"
#undef ZEP_SETTING
  ZEPString GetFrameIconName() override { return "I_PrimaryView"; }

private:
  ZEPAppBinding _binding{"PrimaryView"};
};

// The geometry page shows the application's grid page at its top: the same settings as the
// grid page's, whichever page changes them.
class GeometryPage : public ZEP2DBaseOptGeoFrm {
public:
  explicit GeometryPage(ZEPDialog* iParent) : ZEP2DBaseOptGeoFrm(iParent, "GeometryPage") {}

protected:
#define ZEP_SETTING(Name, Kind) ZEP_APP_BIND_SETTING_HOOKS(Name, Kind)
#include "ZEP2DBaseOptGeoFrm.def"
#undef ZEP_SETTING
  ZEP2DBaseOptGridFrm* CreateGridFrame() override { return new GridPage(this); }

private:
  ZEPAppBinding _binding{"Geometry"};
};

// The main page: the folder standards are those of the standards container (the application
// points it at its standards folder), the PLM standards those the chooser lists.
class MainPage : public ZEP2DBaseOptMainFrm {
public:
  explicit MainPage(ZEPDialog* iParent) : ZEP2DBaseOptMainFrm(iParent, "MainPage") {}

protected:
#define ZEP_SETTING(Name, Kind) ZEP_APP_BIND_SETTING_HOOKS(Name, Kind)
#include "ZEP2DBaseOptMainFrm.def"
#undef ZEP_SETTING
  ZEPString GetFrameIconName() override { return "I_DraftingStandard"; }
  // The default of the standard name: the administrator's when given, else the application's.
  ZEPUnicodeString GetDefaultStandardName() override {
    const ZEPAppSetting* setting = FindSetting("Main", "StandardName");
    if (!setting) return ZEPUnicodeString();
    const ZEPSysSettingRepository* rep = ZEPSysSettingRepository::GetRepository(setting->repository.c_str());
    auto it = rep ? rep->Defaults().find(setting->stored) : std::map<std::string, ZEPSysSettingRepository::Value>::const_iterator();
    if (rep && it != rep->Defaults().end())
      if (const auto* texts = std::get_if<std::vector<std::string>>(&it->second); texts && !texts->empty())
        return ZEPUnicodeString(texts->front());
    return setting->texts.empty() ? ZEPUnicodeString() : ZEPUnicodeString(setting->texts.front());
  }

  ZEPAppBinding _binding{"Main"};
};

// Adding and removing PLM standards changes the PLM lists: the two buttons carry their padlock.
class MainPageWithPLMButtons : public MainPage {
public:
  using MainPage::MainPage;

protected:
  long GetSysStandardPLMAddInfo(ZEPSettingInfo& oInfo) override { return GetSysStandardPLMListInfo(oInfo); }
  long GetSysStandardPLMRemoveInfo(ZEPSettingInfo& oInfo) override { return GetSysStandardPLMListInfo(oInfo); }
};

// Every section of the dimension page is shown, the oriented dimensions' origin symbol too.
class DimensionPage : public ZEP2DBaseOptDimFrm {
public:
  explicit DimensionPage(ZEPDialog* iParent) : ZEP2DBaseOptDimFrm(iParent, "DimensionPage") {}

protected:
#define ZEP_SETTING(Name, Kind) ZEP_APP_BIND_SETTING_HOOKS(Name, Kind)
#include "ZEP2DBaseOptDimFrm.def"
#undef ZEP_SETTING
  unsigned char WithFrmDimOrigin() override { return 1; }

private:
  ZEPAppBinding _binding{"Dimension"};
};

// Every manipulator of dimensions and annotations is shown.
class ManipulatorsPage : public ZEP2DBaseOptManipFrm {
public:
  explicit ManipulatorsPage(ZEPDialog* iParent) : ZEP2DBaseOptManipFrm(iParent, "ManipulatorsPage") {}
  void Build() { ZEP2DBaseOptManipFrm::Build(1); }

protected:
#define ZEP_SETTING(Name, Kind) ZEP_APP_BIND_SETTING_HOOKS(Name, Kind)
#include "ZEP2DBaseOptManipFrm.def"
#undef ZEP_SETTING

private:
  ZEPAppBinding _binding{"Manipulators"};
};

// The administrator's page with every frame; the behaviour dialog keeps its place in the
// user's preferences, in the repository it is read from.
class AdministrationPage : public ZEP2DBaseOptAdminFrm {
public:
  explicit AdministrationPage(ZEPDialog* iParent) : ZEP2DBaseOptAdminFrm(iParent, "AdministrationPage") {}
  void Build() { ZEP2DBaseOptAdminFrm::Build(0); }

protected:
#define ZEP_SETTING(Name, Kind) ZEP_APP_BIND_SETTING_HOOKS(Name, Kind)
#include "ZEP2DBaseOptAdminFrm.def"
#undef ZEP_SETTING
  ZEPString GetFrameIconName() override { return "I_AdminDrawing"; }
  unsigned char WithFrmGVS() override { return 1; }
  unsigned char WithFrmAssemblyMgmt() override { return 1; }
  unsigned char WithFrmTitleBlock() override { return 1; }
  ZEPSysPreferenceRepository* GetDlgPreferenceRepository() override {
    return ZEPSysPreferenceRepository::GetPreferenceRepository("DraftingOptions");
  }

private:
  ZEPAppBinding _binding{"Administration"};
};

// The annotation page bound to a table: "Annotation" for its annotation layout, "Callout" for
// its callout layout, which the info status of the callout size overrun selects.
class AnnotationPage : public ZEP2DBaseOptAnnotFrm {
public:
  AnnotationPage(ZEPDialog* iParent, const char* iTable, bool iCalloutLayout)
      : ZEP2DBaseOptAnnotFrm(iParent, "AnnotationPage"), _calloutLayout(iCalloutLayout),
        _binding(iTable) {}

protected:
#define ZEP_SETTING(Name, Kind) ZEP_APP_BIND_SETTING_HOOKS(Name, Kind)
#include "ZEP2DBaseOptAnnotFrm.def"
#undef ZEP_SETTING
  ZEPString GetLegendTableLayoutContext() override { return "DrwLegendTable"; }

  bool _calloutLayout;

private:
  ZEPAppBinding _binding;
};

// Answers the callout info hook with its lock record and a status that picks the layout.
class AnnotationLayoutPage : public AnnotationPage {
public:
  AnnotationLayoutPage(ZEPDialog* iParent, const char* iTable, bool iCalloutLayout)
      : AnnotationPage(iParent, iTable, iCalloutLayout) {}

protected:
  long GetSysCalloutSizeOverrunInfo(ZEPSettingInfo& oInfo) override {
    AnnotationPage::GetSysCalloutSizeOverrunInfo(oInfo);
    return _calloutLayout ? S_OK : 1; // a success, but not the callout host's exact 0
  }
};

ZEPDlgFrame* OpenAnnotation(ZEPDialog* iParent) {
  auto* page = new AnnotationLayoutPage(iParent, "Annotation", false);
  page->Build();
  page->Initialize();
  return page;
}

ZEPDlgFrame* OpenCallouts(ZEPDialog* iParent) {
  auto* page = new AnnotationLayoutPage(iParent, "Callout", true);
  page->Build();
  page->Initialize();
  return page;
}

// The display page with every optional frame.
class DisplayPage : public ZEP2DBaseOptDisplayFrm {
public:
  explicit DisplayPage(ZEPDialog* iParent) : ZEP2DBaseOptDisplayFrm(iParent, "DisplayPage") {}
  void Build() {
    int row = 0;
    ZEP2DBaseOptDisplayFrm::Build(row, 1);
  }

protected:
#define ZEP_SETTING(Name, Kind) ZEP_APP_BIND_SETTING_HOOKS(Name, Kind)
#include "ZEP2DBaseOptDisplayFrm.def"
#undef ZEP_SETTING
  unsigned char WithFrmVisualization() override { return 1; }
  unsigned char WithFrmGeometries() override { return 1; }
  unsigned char WithFrmCallouts() override { return 1; }
  unsigned char WithFrmWelding() override { return 1; }
  unsigned char WithFrmPatterns() override { return 1; }
  unsigned char WithFrmCapping() override { return 1; }

private:
  ZEPAppBinding _binding{"Display"};
};

template <class Page> ZEPDlgFrame* Open(ZEPDialog* iParent) {
  auto* page = new Page(iParent);
  page->Build();
  page->Initialize();
  return page;
}

#define ZEP_SETTING(Name, Kind) {#Name, StoredOf<ZEP_TYPE_##Kind>()},
const std::map<std::string, ZEPAppStored> kGridStored = {
#include "ZEP2DBaseOptGridFrm.def"
};
const std::map<std::string, ZEPAppStored> kGeneralStored = {
#include "ZEP2DBaseOptGalFrm.def"
};
const std::map<std::string, ZEPAppStored> kMainStored = {
#include "ZEP2DBaseOptMainFrm.def"
};
const std::map<std::string, ZEPAppStored> kPrimaryViewStored = {
#include "ZEP2DBasePrimaryViewFrm.def"
};
const std::map<std::string, ZEPAppStored> kDimensionStored = {
#include "ZEP2DBaseOptDimFrm.def"
};
const std::map<std::string, ZEPAppStored> kGeometryStored = {
#include "ZEP2DBaseOptGeoFrm.def"
};
const std::map<std::string, ZEPAppStored> kManipulatorsStored = {
#include "ZEP2DBaseOptManipFrm.def"
};
const std::map<std::string, ZEPAppStored> kAdministrationStored = {
#include "ZEP2DBaseOptAdminFrm.def"
};
const std::map<std::string, ZEPAppStored> kAnnotationStored = {
#include "ZEP2DBaseOptAnnotFrm.def"
};
const std::map<std::string, ZEPAppStored> kDisplayStored = {
#include "ZEP2DBaseOptDisplayFrm.def"
};
#undef ZEP_SETTING

#define ZEP_SETTING(Name, Kind) ZEP_APP_FLAG_##Kind(Name)
#define ZEP_APP_FLAG_Flag(Name) #Name,
#define ZEP_APP_FLAG_Int(Name)
#define ZEP_APP_FLAG_UInt(Name)
#define ZEP_APP_FLAG_Double(Name)
#define ZEP_APP_FLAG_Text(Name)
#define ZEP_APP_FLAG_TextList(Name)
#define ZEP_APP_FLAG_FlagArray(Name) #Name,
#define ZEP_APP_FLAG_IntArray(Name)
#define ZEP_APP_FLAG_DoubleArray(Name)
#define ZEP_APP_FLAG_ColorInt(Name)
#define ZEP_APP_FLAG_ColorUInt(Name)
const std::set<std::string> kGridFlags = {
#include "ZEP2DBaseOptGridFrm.def"
};
const std::set<std::string> kGeneralFlags = {
#include "ZEP2DBaseOptGalFrm.def"
};
const std::set<std::string> kMainFlags = {
#include "ZEP2DBaseOptMainFrm.def"
};
const std::set<std::string> kPrimaryViewFlags = {
#include "ZEP2DBasePrimaryViewFrm.def"
};
const std::set<std::string> kDimensionFlags = {
#include "ZEP2DBaseOptDimFrm.def"
};
const std::set<std::string> kGeometryFlags = {
#include "ZEP2DBaseOptGeoFrm.def"
};
const std::set<std::string> kManipulatorsFlags = {
#include "ZEP2DBaseOptManipFrm.def"
};
const std::set<std::string> kAdministrationFlags = {
#include "ZEP2DBaseOptAdminFrm.def"
};
const std::set<std::string> kAnnotationFlags = {
#include "ZEP2DBaseOptAnnotFrm.def"
};
const std::set<std::string> kDisplayFlags = {
#include "ZEP2DBaseOptDisplayFrm.def"
};
#undef ZEP_SETTING

// Settings whose control a page builds only when an environment variable is set.
const struct {
  const char* page;
  const char* attribute;
  const char* variable;
} kEnvironmentGated[] = {{"Administration", "PrevTrueDim", "ZEP_TDE_LA"}};
} // namespace

const std::vector<ZEPAppPage>& AppPages() {
  static const std::vector<ZEPAppPage> pages = {
      // clang-format off
      {"main", "Standard and scale", "Main", &Open<MainPageWithPLMButtons>, kMainStored, {}, {}, kMainFlags},
      {"general", "General", "General", &Open<GeneralPage>, kGeneralStored, {}, {}, kGeneralFlags},
      {"dimension", "Dimension", "Dimension", &Open<DimensionPage>, kDimensionStored, {"pushAssoc3D"}, {},
       kDimensionFlags},
      {"grid", "Grid", "Grid", &Open<GridPage>, kGridStored, {}, {}, kGridFlags},
      {"geometry", "Geometry", "Geometry", &Open<GeometryPage>, kGeometryStored,
       {"dragOptionPushButton", "smartPickPushButton", "cstTypesPushButton"}, {"Grid"}, kGeometryFlags},
      {"primary-view", "Primary view", "PrimaryView", &Open<PrimaryViewPage>, kPrimaryViewStored, {}, {},
       kPrimaryViewFlags},
      {"manipulators", "Manipulators", "Manipulators", &Open<ManipulatorsPage>, kManipulatorsStored, {}, {},
       kManipulatorsFlags},
      {"administration", "Administration", "Administration", &Open<AdministrationPage>, kAdministrationStored,
       {"pushPropTbBehavior"}, {}, kAdministrationFlags},
      {"annotation", "Annotation", "Annotation", &OpenAnnotation, kAnnotationStored, {}, {}, kAnnotationFlags},
      {"callouts", "Callouts", "Callout", &OpenCallouts, kAnnotationStored, {}, {}, kAnnotationFlags},
      {"display", "Display", "Display", &Open<DisplayPage>, kDisplayStored,
       {"diagElementsColorsPushButton", "diagGeometriesColorsPushButton"}, {}, kDisplayFlags},
      // clang-format on
  };
  return pages;
}

bool ZEPAppPage::Shows(const ZEPAppSetting& iSetting) const {
  for (const auto& gated : kEnvironmentGated)
    if (iSetting.page == gated.page && iSetting.attribute == gated.attribute &&
        !ZEPGetEnv(gated.variable))
      return false;
  return iSetting.page == table ||
         std::find(embedded.begin(), embedded.end(), iSetting.page) != embedded.end();
}

const ZEPAppPage* FindPage(const std::string& iName) {
  for (const ZEPAppPage& p : AppPages())
    if (p.name == iName) return &p;
  return nullptr;
}

std::vector<std::string> AppRepositories() {
  std::set<std::string> names;
  for (const ZEPAppSetting& s : AppSettings())
    names.insert(s.repository);
  return {names.begin(), names.end()};
}

std::vector<std::string> DisagreeingSettings() {
  // Lists that run in parallel, entry i of one belonging to entry i of the other.
  static const struct {
    const char *page, *first, *second;
  } kParallel[] = {{"Main", "StandardPLMList", "StandardPLMIDList"}};
  std::vector<std::string> found;
  for (const auto& pair : kParallel) {
    const ZEPAppSetting* first = FindSetting(pair.page, pair.first);
    const ZEPAppSetting* second = FindSetting(pair.page, pair.second);
    std::vector<std::string> a, b;
    for (auto [row, texts] : {std::make_pair(first, &a), std::make_pair(second, &b)})
      if (const ZEPSysSettingRepository* rep = row ? ZEPSysSettingRepository::GetRepository(row->repository.c_str()) : nullptr)
        rep->ReadAttr(row->stored.c_str(), *texts);
    if (first && second && a.size() != b.size())
      found.push_back(first->stored + " holds " + std::to_string(a.size()) + " names and " + second->stored + " " +
                      std::to_string(b.size()) + " keys: they go in pairs, so no PLM standard is shown, and adding "
                      "or removing one replaces both lists");
  }
  return found;
}

const ZEPAppPage* TablePage(const ZEPAppSetting& iSetting) {
  for (const ZEPAppPage& p : AppPages())
    if (p.table == iSetting.page) return &p;
  return nullptr;
}

ZEPAppStored StoredKindOf(const ZEPAppSetting& iSetting) {
  const ZEPAppPage* page = TablePage(iSetting);
  if (!page) return ZEPAppStored::Unsupported;
  const auto kind = page->stored.find(iSetting.attribute);
  return kind == page->stored.end() ? ZEPAppStored::Unsupported : kind->second;
}

void ApplyDefaults() {
  for (const ZEPAppSetting& s : AppSettings()) {
    ZEPSysSettingRepository* rep = ZEPSysSettingRepository::GetRepository(s.repository.c_str(), 0);
    if (!rep) rep = ZEPSysSettingRepository::Open(s.repository);
    if (rep->Defaults().count(s.stored)) continue; // the administrator's default wins
    switch (StoredKindOf(s)) {
    case ZEPAppStored::Int:
      rep->SetDefault(s.stored, std::vector<int>(s.defaults.begin(), s.defaults.end()));
      break;
    case ZEPAppStored::UInt:
      rep->SetDefault(s.stored, std::vector<unsigned int>(s.defaults.begin(), s.defaults.end()));
      break;
    case ZEPAppStored::Double:
      rep->SetDefault(s.stored, s.defaults);
      break;
    case ZEPAppStored::Text:
    case ZEPAppStored::TextList:
      rep->SetDefault(s.stored, s.texts);
      break;
    case ZEPAppStored::Unsupported:
      break;
    }
  }
}

} // namespace zepapp
