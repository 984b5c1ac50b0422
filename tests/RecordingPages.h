// Recording hosts of each page, generated from the pages' attribute tables.
#pragma once

#include "PageRecorder.h"

#include "ZEP2DBaseOptAdminFrm.h"
#include "ZEP2DBaseOptAnnotFrm.h"
#include "ZEP2DBaseOptDimFrm.h"
#include "ZEP2DBaseOptDisplayFrm.h"
#include "ZEP2DBaseOptGalFrm.h"
#include "ZEP2DBaseOptGeoFrm.h"
#include "ZEP2DBaseOptGridFrm.h"
#include "ZEP2DBaseOptMainFrm.h"
#include "ZEP2DBaseOptManipFrm.h"
#include "ZEP2DBasePrimaryViewFrm.h"

// Each class below records the hooks of the attributes its page's table lists.
#define ZEP_SETTING(Name, Kind) ZEP_RECORD_SETTING_HOOKS(Name, Kind)

class RecordingGridPage : public Recording<ZEP2DBaseOptGridFrm> {
public:
  RecordingGridPage(HookScript& iScript, ZEPDialog* iParent) : Recording(iScript, iParent, "GridPage") {}
protected:
#include "ZEP2DBaseOptGridFrm.def"
};

class RecordingGalPage : public Recording<ZEP2DBaseOptGalFrm> {
public:
  RecordingGalPage(HookScript& iScript, ZEPDialog* iParent) : Recording(iScript, iParent, "GeneralPage") {}
protected:
#include "ZEP2DBaseOptGalFrm.def"
};

class RecordingPrimaryViewPage : public Recording<ZEP2DBasePrimaryViewFrm> {
public:
  RecordingPrimaryViewPage(HookScript& iScript, ZEPDialog* iParent) : Recording(iScript, iParent) {}
protected:
#include "ZEP2DBasePrimaryViewFrm.def"
  ZEPString GetFrameIconName() override { return "I_PrimaryView"; }
};

// The geometry page embeds a recording grid page on the same script, unless the script's
// "CreateGridFrame" option is 0.
class RecordingGeoPage : public Recording<ZEP2DBaseOptGeoFrm> {
public:
  RecordingGeoPage(HookScript& iScript, ZEPDialog* iParent) : Recording(iScript, iParent, "GeometryPage") {}
protected:
#include "ZEP2DBaseOptGeoFrm.def"
  ZEP2DBaseOptGridFrm* CreateGridFrame() override {
    return _script.Option("CreateGridFrame", 1) ? new RecordingGridPage(_script, this) : nullptr;
  }
};

// The manipulators page: its layout option from the script's "WithDimManipSection"; Build's
// flag from "BuildFlag" (1 unless scripted).
class RecordingManipPage : public Recording<ZEP2DBaseOptManipFrm> {
public:
  RecordingManipPage(HookScript& iScript, ZEPDialog* iParent) : Recording(iScript, iParent, "ManipulatorsPage") {}
  void Build() { ZEP2DBaseOptManipFrm::Build(static_cast<unsigned char>(_script.Option("BuildFlag", 1))); }

protected:
#include "ZEP2DBaseOptManipFrm.def"
  unsigned char WithDimManipSection() override {
    return static_cast<unsigned char>(
        _script.Option("WithDimManipSection", ZEP2DBaseOptManipFrm::WithDimManipSection()));
  }
};

// The administration page: its host operations from the script ("WithFrmGVS",
// "WithFrmAssemblyMgmt", "WithFrmTitleBlock", all 1 unless scripted; "BuildFlag", 0 unless
// scripted); every call to WithFrmGVS is counted in the script's reads. The behaviour dialog's
// place is saved in the preference repository named by the "SaveTo" text ("DraftingOptions"
// unless scripted; an empty text: none).
class RecordingAdminPage : public Recording<ZEP2DBaseOptAdminFrm> {
public:
  RecordingAdminPage(HookScript& iScript, ZEPDialog* iParent) : Recording(iScript, iParent, "AdministrationPage") {}
  void Build() { ZEP2DBaseOptAdminFrm::Build(static_cast<unsigned char>(_script.Option("BuildFlag", 0))); }

protected:
#include "ZEP2DBaseOptAdminFrm.def"
  ZEPString GetFrameIconName() override { return "I_AdminDrawing"; }
  unsigned char WithFrmGVS() override {
    _script.reads.push_back("WithFrmGVS");
    return static_cast<unsigned char>(_script.Option("WithFrmGVS", 1));
  }
  unsigned char WithFrmAssemblyMgmt() override {
    return static_cast<unsigned char>(_script.Option("WithFrmAssemblyMgmt", 1));
  }
  unsigned char WithFrmTitleBlock() override {
    return static_cast<unsigned char>(_script.Option("WithFrmTitleBlock", 1));
  }
  ZEPSysPreferenceRepository* GetDlgPreferenceRepository() override {
    auto it = _script.texts.find("SaveTo");
    const std::string name = it == _script.texts.end() ? "DraftingOptions" : it->second;
    return name.empty() ? nullptr : ZEPSysPreferenceRepository::GetPreferenceRepository(name.c_str());
  }
};

// The main page answers its icon and default standard from the script's "GetFrameIconName"
// and "GetDefaultStandardName" answers.
class RecordingMainPage : public Recording<ZEP2DBaseOptMainFrm> {
public:
  RecordingMainPage(HookScript& iScript, ZEPDialog* iParent) : Recording(iScript, iParent, "MainPage") {}
protected:
  ZEPString GetFrameIconName() override { return _script.Answer("GetFrameIconName"); }
  ZEPUnicodeString GetDefaultStandardName() override { return _script.Answer("GetDefaultStandardName"); }
#include "ZEP2DBaseOptMainFrm.def"
};

// A page built and initialised on iParent, as the host does it.
template <class Page> Page* OpenPage(HookScript& iScript, ZEPDialog* iParent) {
  auto* page = new Page(iScript, iParent);
  page->Build();
  page->Initialize();
  return page;
}

// The dimension page; its layout options answer from the script, else as the module does.
class RecordingDimPage : public Recording<ZEP2DBaseOptDimFrm> {
public:
  RecordingDimPage(HookScript& iScript, ZEPDialog* iParent) : Recording(iScript, iParent, "DimensionPage") {}
protected:
#include "ZEP2DBaseOptDimFrm.def"
  unsigned char WithFrmCreateDriveAndChamfer() override {
    return _script.Option("WithFrmCreateDriveAndChamfer", ZEP2DBaseOptDimFrm::WithFrmCreateDriveAndChamfer()) != 0;
  }
  unsigned char WithLineUpValues() override {
    return _script.Option("WithLineUpValues", ZEP2DBaseOptDimFrm::WithLineUpValues()) != 0;
  }
  unsigned char WithFrmDimOrigin() override {
    return _script.Option("WithFrmDimOrigin", ZEP2DBaseOptDimFrm::WithFrmDimOrigin()) != 0;
  }
};
// The annotation page: the legend table layout context is the script's "LegendContext" text.
class RecordingAnnotPage : public Recording<ZEP2DBaseOptAnnotFrm> {
public:
  RecordingAnnotPage(HookScript& iScript, ZEPDialog* iParent) : Recording(iScript, iParent, "AnnotationPage") {}
protected:
#include "ZEP2DBaseOptAnnotFrm.def"
  ZEPString GetLegendTableLayoutContext() override {
    auto it = _script.texts.find("LegendContext");
    return it == _script.texts.end() ? ZEPString("DrwLegend") : ZEPString(it->second);
  }
};

// The display page: layout predicates from the script's options (every frame by default);
// Build places the frames from the script's "FirstRow" and, unless "WithTrackHistory" is 0,
// allows the track history check. The row after the last frame is kept in nextRow.
class RecordingDisplayPage : public Recording<ZEP2DBaseOptDisplayFrm> {
public:
  RecordingDisplayPage(HookScript& iScript, ZEPDialog* iParent) : Recording(iScript, iParent, "DisplayPage") {}
  void Build() {
    nextRow = static_cast<int>(_script.Option("FirstRow", 0));
    ZEP2DBaseOptDisplayFrm::Build(nextRow, static_cast<unsigned char>(_script.Option("WithTrackHistory", 1)));
  }
  int nextRow = 0;

protected:
#include "ZEP2DBaseOptDisplayFrm.def"
  unsigned char WithFrmVisualization() override { return Predicate("WithFrmVisualization"); }
  unsigned char WithFrmGeometries() override { return Predicate("WithFrmGeometries"); }
  unsigned char WithFrmCallouts() override { return Predicate("WithFrmCallouts"); }
  unsigned char WithFrmWelding() override { return Predicate("WithFrmWelding"); }
  unsigned char WithFrmPatterns() override { return Predicate("WithFrmPatterns"); }
  unsigned char WithFrmCapping() override { return Predicate("WithFrmCapping"); }

private:
  unsigned char Predicate(const char* iName) { return _script.Option(iName, 1) ? 1 : 0; }
};
#undef ZEP_SETTING

// The attributes of each page's table, in table order.
#define ZEP_SETTING(Name, Kind) #Name,
inline const std::vector<std::string> kGridAttributes = {
#include "ZEP2DBaseOptGridFrm.def"
};
inline const std::vector<std::string> kGalAttributes = {
#include "ZEP2DBaseOptGalFrm.def"
};
inline const std::vector<std::string> kPrimaryViewAttributes = {
#include "ZEP2DBasePrimaryViewFrm.def"
};
inline const std::vector<std::string> kDimAttributes = {
#include "ZEP2DBaseOptDimFrm.def"
};
inline const std::vector<std::string> kGeoAttributes = {
    // with those of the embedded grid page
#include "ZEP2DBaseOptGeoFrm.def"
#include "ZEP2DBaseOptGridFrm.def"
};
inline const std::vector<std::string> kManipAttributes = {
#include "ZEP2DBaseOptManipFrm.def"
};
inline const std::vector<std::string> kAdminAttributes = {
#include "ZEP2DBaseOptAdminFrm.def"
};
inline const std::vector<std::string> kMainAttributes = {
#include "ZEP2DBaseOptMainFrm.def"
};
inline const std::vector<std::string> kAnnotAttributes = {
#include "ZEP2DBaseOptAnnotFrm.def"
};
inline const std::vector<std::string> kDisplayAttributes = {
#include "ZEP2DBaseOptDisplayFrm.def"
};
#undef ZEP_SETTING

// A page under test: the host's script, the page opened in a window of its own, and the ways
// the user reaches its controls. A control is looked for on the page, or in iIn when given (a
// dialog the page opened).
template <class P> class PageTest : public ZEPHostTest {
protected:
  // The host has the drafting options open: paper lengths read their unit there.
  void SetUp() override {
    ZEPHostTest::SetUp();
    _pOptions = ZEPSysSettingRepository::Open("DraftingOptions");
  }
  // A fresh page, built and initialised; the previous one goes with its window.
  P* Open() {
    delete _pWindow;
    _pWindow = new ZEPDlgWindow(&_root, "window", 0);
    return _pPage = OpenPage<P>(_script, _pWindow);
  }
  ZEPDialog* Root(ZEPDialog* iIn) { return iIn ? iIn : _pPage; }
  ZEPDialog* Find(const std::string& iName, ZEPDialog* iIn = nullptr) { return ZEPDlgDriver::Find(Root(iIn), iName); }
  ZEPDialog* Control(const std::string& iName, ZEPDialog* iIn = nullptr) {
    return ZEPDlgDriver::FindControl(Root(iIn), iName);
  }
  template <class T> T* As(const std::string& iName, ZEPDialog* iIn = nullptr) {
    return ZEPSysDynamicCast<T>(Control(iName, iIn));
  }
  ZEPDlgSpinner* Spinner(const std::string& iName, ZEPDialog* iIn = nullptr) { return As<ZEPDlgSpinner>(iName, iIn); }
  ZEPDlgCombo* Combo(const std::string& iName, ZEPDialog* iIn = nullptr) { return As<ZEPDlgCombo>(iName, iIn); }
  ZEPDlgRadioButton* Radio(const std::string& iName, ZEPDialog* iIn = nullptr) {
    return As<ZEPDlgRadioButton>(iName, iIn);
  }
  // A check button or radio button that is on; any other widget, or none, fails the test.
  bool Checked(const std::string& iName, ZEPDialog* iIn = nullptr) {
    if (auto* radio = Radio(iName, iIn)) return radio->GetState() == ZEPDlgChecked;
    auto* check = As<ZEPDlgCheckButton>(iName, iIn);
    if (!check) ADD_FAILURE() << iName << " is no check or radio button";
    return check && check->GetState() == ZEPDlgChecked;
  }
  bool Enabled(const std::string& iName, ZEPDialog* iIn = nullptr) {
    return Control(iName, iIn)->IsEffectivelyEnabled();
  }
  bool Click(const std::string& iName, ZEPDialog* iIn = nullptr) { return ZEPDlgDriver::Click(Control(iName, iIn)); }
  short Row(const std::string& iName, ZEPDialog* iIn = nullptr) { return Find(iName, iIn)->GetGridConstraints().row; }
  // The radios of a group that are on, joined by "+".
  std::string Selected(const std::vector<const char*>& iRadios, ZEPDialog* iIn = nullptr) {
    std::string on;
    for (const char* name : iRadios)
      if (Checked(name, iIn)) on += on.empty() ? name : std::string("+") + name;
    return on;
  }
  std::vector<std::string> Lines(const std::string& iCombo, ZEPDialog* iIn = nullptr) {
    ZEPDlgCombo* combo = Combo(iCombo, iIn);
    return combo ? ComboLines(*combo) : std::vector<std::string>{};
  }
  std::vector<std::string> Hooks() { return _script.Hooks(); }
  // The first number of every call of iHook, in order.
  std::vector<double> Written(const std::string& iHook) {
    std::vector<double> values;
    for (const HookCall& call : _script.Calls(iHook)) values.push_back(call.values.at(0));
    return values;
  }
  // Presses the push button and answers the dialog of that name it opened.
  ZEPDlgDialog* OpenDialog(const std::string& iButton, const std::string& iDialog) {
    EXPECT_TRUE(Click(iButton)) << iButton;
    return ZEPSysDynamicCast<ZEPDlgDialog>(Find(iDialog));
  }
  // The page's own children of that name (its dialogs).
  std::vector<ZEPDialog*> Children(const std::string& iName) {
    std::vector<ZEPDialog*> found;
    for (ZEPDialog* child : _pPage->GetChildren())
      if (child->GetOwnName() == iName) found.push_back(child);
    return found;
  }

  HookScript _script;
  P* _pPage = nullptr;
  ZEPDlgWindow* _pWindow = nullptr;
  ZEPSysSettingRepository* _pOptions = nullptr;
};
