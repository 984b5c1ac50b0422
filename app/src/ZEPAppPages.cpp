#include "ZEPAppPages.h"

#include "ZEP2DBaseOptAnnotFrm.h"
#include "ZEP2DBaseOptDisplayFrm.h"
#include "ZEP2DBaseOptGalFrm.h"
#include "ZEP2DBaseOptGeoFrm.h"
#include "ZEP2DBaseOptGridFrm.h"
#include "ZEP2DBasePrimaryViewFrm.h"

#include <algorithm>
#include <set>

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
const std::map<std::string, ZEPAppStored> kPrimaryViewStored = {
#include "ZEP2DBasePrimaryViewFrm.def"
};
const std::map<std::string, ZEPAppStored> kGeometryStored = {
#include "ZEP2DBaseOptGeoFrm.def"
};
const std::map<std::string, ZEPAppStored> kAnnotationStored = {
#include "ZEP2DBaseOptAnnotFrm.def"
};
const std::map<std::string, ZEPAppStored> kDisplayStored = {
#include "ZEP2DBaseOptDisplayFrm.def"
};
#undef ZEP_SETTING
} // namespace

const std::vector<ZEPAppPage>& AppPages() {
  static const std::vector<ZEPAppPage> pages = {
      {"general", "General", "General", &Open<GeneralPage>, kGeneralStored, {}, {}},
      {"grid", "Grid", "Grid", &Open<GridPage>, kGridStored, {}, {}},
      {"geometry",
       "Geometry",
       "Geometry",
       &Open<GeometryPage>,
       kGeometryStored,
       {"dragOptionPushButton", "smartPickPushButton", "cstTypesPushButton"},
       {"Grid"}},
      {"primary-view",
       "Primary view",
       "PrimaryView",
       &Open<PrimaryViewPage>,
       kPrimaryViewStored,
       {},
       {}},
      {"annotation", "Annotation", "Annotation", &OpenAnnotation, kAnnotationStored, {}, {}},
      {"callouts", "Callouts", "Callout", &OpenCallouts, kAnnotationStored, {}, {}},
      {"display",
       "Display",
       "Display",
       &Open<DisplayPage>,
       kDisplayStored,
       {"diagElementsColorsPushButton", "diagGeometriesColorsPushButton"},
       {}},
  };
  return pages;
}

bool ZEPAppPage::Shows(const ZEPAppSetting& iSetting) const {
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

void ApplyDefaults() {
  for (const ZEPAppSetting& s : AppSettings()) {
    ZEPSysSettingRepository* rep = ZEPSysSettingRepository::GetRepository(s.repository.c_str(), 0);
    if (!rep) rep = ZEPSysSettingRepository::Open(s.repository);
    if (rep->Defaults().count(s.stored)) continue; // the administrator's default wins
    const ZEPAppPage* page = nullptr;
    for (const ZEPAppPage& p : AppPages())
      if (p.table == s.page) page = &p;
    auto kind = page ? page->stored.find(s.attribute)
                     : std::map<std::string, ZEPAppStored>::const_iterator();
    if (!page || kind == page->stored.end()) continue;
    switch (kind->second) {
    case ZEPAppStored::Int:
      rep->SetDefault(s.stored, std::vector<int>(s.defaults.begin(), s.defaults.end()));
      break;
    case ZEPAppStored::UInt:
      rep->SetDefault(s.stored, std::vector<unsigned int>(s.defaults.begin(), s.defaults.end()));
      break;
    case ZEPAppStored::Double:
      rep->SetDefault(s.stored, s.defaults);
      break;
    case ZEPAppStored::Unsupported:
      break;
    }
  }
}

} // namespace zepapp
