#include "ZEPAppSketcher.h"

#include "ZEPAppSettingsFile.h"
#include "ZEPScalesServices.h"

#include <algorithm>
#include <cstdio>
#include <iomanip>
#include <ostream>
#include <sstream>
#include <string>
#include <vector>

namespace zepapp {
namespace {
using Adapt = ZEP2DBaseSketcherSettingsAdapt;

// ---- which event a stored attribute sends: the adapter's own pairing of setter and event ----
struct EventOf {
  const char* const* name;
  bool specific;
  void (Adapt::*dispatch)();
};

// clang-format off
const EventOf kEvents[] = {
    {&Adapt::mstrGridDisplay, true, &Adapt::GridModify},
    {&Adapt::mstrGridSnapPt, true, &Adapt::SnapModify},
    {&Adapt::mstrGridHPrSpacing, true, &Adapt::GridModify},
    {&Adapt::mstrGridHSecStep, true, &Adapt::GridModify},
    {&Adapt::mstrAllowDistortions, true, &Adapt::GridModify},
    {&Adapt::mstrGridVPrSpacing, true, &Adapt::GridModify},
    {&Adapt::mstrGridVSecStep, true, &Adapt::GridModify},
    {&Adapt::mstrDiagElts, true, &Adapt::GeomUIModify},
    {&Adapt::mstrColorDiagOverDefinedElts, true, &Adapt::GeomUIModify},
    {&Adapt::mstrColorDiagNotConsistentElts, true, &Adapt::GeomUIModify},
    {&Adapt::mstrColorDiagNotChangedElts, true, &Adapt::GeomUIModify},
    {&Adapt::mstrColorDiagWellDefinedElts, true, &Adapt::GeomUIModify},
    {&Adapt::mstrGeomCreateCenter, false, &Adapt::GeomUIModify},
    {&Adapt::mstrCpltPosSupport, false, &Adapt::CpltModify},
    {&Adapt::mstrCpltPosHorVertTo, false, &Adapt::CpltModify},
    {&Adapt::mstrCpltDirHorVert, false, &Adapt::CpltModify},
    {&Adapt::mstrCpltDirParPerpTan, false, &Adapt::CpltModify},
    {&Adapt::mstrCpltCreateConstraint, false, &Adapt::CpltModify},
    {&Adapt::mstrDragWithEndPts, false, &Adapt::GeomUIModify},
    {&Adapt::mstrDragMode, false, &Adapt::GeomUIModify},
    {&Adapt::mstrDragElts, false, &Adapt::GeomUIModify},
    {&Adapt::mstrColorConstructElts, false, &Adapt::GeomUIModify},
    {&Adapt::mstrColorSmartPick, false, &Adapt::GeomUIModify},
    {&Adapt::mstrShowPosition, false, &Adapt::CpltModify},
};
// clang-format on

// ---- the page write observer, shared by the live instances ----------------------------------
// The binding has room for one observer; it is installed while any instance lives.
std::vector<ZEPAppSketcherSettings*>& LiveInstances() {
  static std::vector<ZEPAppSketcherSettings*> live;
  return live;
}

bool IsLive(const ZEPAppSketcherSettings* iSettings) {
  const auto& live = LiveInstances();
  return std::find(live.begin(), live.end(), iSettings) != live.end();
}

void OnPageWrite(const ZEPAppSetting& iSetting) {
  // A listener may create or destroy instances: go over those alive when the write happened,
  // skipping any destroyed since.
  const std::vector<ZEPAppSketcherSettings*> snapshot = LiveInstances();
  for (ZEPAppSketcherSettings* settings : snapshot)
    if (IsLive(settings)) settings->NotifyPageWrite(iSetting);
}

ZEPSysSettingRepository* OpenRepository(ZEPAppSettingsFile* iFile, const char* iName) {
  return iFile ? iFile->OpenSettings(iName) : ZEPSysSettingRepository::Open(iName);
}

constexpr unsigned int kPlainGeometryColor = 0xFFFFFF;
} // namespace

ZEPAppSketcherSettings::ZEPAppSketcherSettings(ZEPAppSettingsFile* iFile) {
  _pSettRep = OpenRepository(iFile, kSketcherGeneralRepository);
  _pSpecificSettRep = OpenRepository(iFile, kSketcherSpecificRepository);
  LiveInstances().push_back(this);
  if (LiveInstances().size() == 1) SetWriteObserver(&OnPageWrite);
}

ZEPAppSketcherSettings::~ZEPAppSketcherSettings() {
  auto& live = LiveInstances();
  live.erase(std::remove(live.begin(), live.end(), this), live.end());
  if (live.empty()) SetWriteObserver(nullptr);
}

unsigned int ZEPAppSketcherSettings::GetDefaultColorDiagElts(ZEP2DCstDiag iDiag) {
  switch (static_cast<int>(iDiag)) {
  case ZEP2DCstOverDefined:
    return 0xFF00FF;
  case ZEP2DCstNotConsistent:
    return 0xFF0000;
  case ZEP2DCstNotChanged:
    return 0x800000;
  case ZEP2DCstWellDefined:
    return 0x00FF00;
  default:
    return kPlainGeometryColor;
  }
}

bool ZEPAppSketcherSettings::NotifyPageWrite(const ZEPAppSetting& iSetting) {
  // The page wrote through the registry; only a write into the very repository the adapter
  // reads that attribute from is a change of the sketcher's settings.
  ZEPSysSettingRepository* written =
      ZEPSysSettingRepository::GetRepository(iSetting.repository.c_str());
  if (!written) return false;
  for (const EventOf& e : kEvents) {
    if (iSetting.stored != *e.name) continue;
    if (written != (e.specific ? _pSpecificSettRep : _pSettRep)) return false;
    (this->*e.dispatch)();
    return true;
  }
  return false;
}

// ---- the listing ------------------------------------------------------------------------------
namespace {
std::string Number(double iValue) {
  char text[32];
  std::snprintf(text, sizeof text, "%.10g", iValue);
  return text;
}

const char* OnOff(int iValue) { return iValue ? "on" : "off"; }

std::string RangeName(int iRange) {
  ZEPICkeScalesServices_var scales = ZEPGlobalFunctions2::GetScalesServices();
  const std::string name =
      scales ? scales->GetScaleName(static_cast<ZEPCkeScale>(iRange)).str() : "";
  return std::to_string(iRange) + (name.empty() ? "" : " " + name);
}

std::string Rgb(unsigned int iRed, unsigned int iGreen, unsigned int iBlue) {
  char text[48];
  std::snprintf(text, sizeof text, "%u %u %u (#%02X%02X%02X)", iRed, iGreen, iBlue, iRed & 0xFFu,
                iGreen & 0xFFu, iBlue & 0xFFu);
  return text;
}

class Listing {
public:
  explicit Listing(std::ostream& oOut) : _out(oOut) {}
  void Section(const char* iTitle) { _out << iTitle << '\n'; }
  void Row(const char* iLabel, const std::string& iValue) {
    _out << "  " << std::left << std::setw(32) << iLabel << iValue << '\n';
  }
  void Row(const char* iLabel, const char* iValue) { Row(iLabel, std::string(iValue)); }
  // Cells of 16 characters, without trailing blanks.
  template <class... Cells> void Columns(const Cells&... iCells) {
    std::ostringstream line;
    line << "  " << std::left;
    ((line << std::setw(16) << iCells), ...);
    std::string text = line.str();
    text.erase(text.find_last_not_of(' ') + 1);
    _out << text << '\n';
  }

private:
  std::ostream& _out;
};
} // namespace

void PrintSketcherSettings(ZEPSketcherSettings& iSettings, std::ostream& oOut) {
  Listing out(oOut);
  out.Section("Grid");
  out.Row("display", OnOff(iSettings.GetGridVisuMode()));
  out.Row("snap to points", OnOff(iSettings.GetGridSnapMode()));
  out.Columns("range", "spacing H (mm)", "graduations H", "distortions", "spacing V (mm)",
              "graduations V");
  for (int k = 1; k <= 5; ++k) {
    const ZEPCkeScale range = static_cast<ZEPCkeScale>(k);
    out.Columns(RangeName(k), Number(iSettings.GetGridPrimSpac(range)),
                std::to_string(iSettings.GetGridSecStep(range)),
                OnOff(iSettings.GetAllowDistortions(range)),
                Number(iSettings.GetGridVPrimSpac(range)),
                std::to_string(iSettings.GetGridVSecStep(range)));
  }

  out.Section("Creation and completion");
  out.Row("create centres", OnOff(iSettings.GetCreateCenter()));
  out.Row("position on supports", OnOff(iSettings.GetPosSupports()));
  out.Row("horizontal/vertical position", OnOff(iSettings.GetPosHorVertTo()));
  out.Row("horizontal/vertical direction", OnOff(iSettings.GetDirHorVert()));
  out.Row("parallel/perpendicular/tangent", OnOff(iSettings.GetDirParaPerpTan()));
  out.Row("create detected constraints", OnOff(iSettings.GetCreateConstraint()));
  out.Row("show position", OnOff(iSettings.GetShowPosition()));

  out.Section("Drag");
  out.Row("with end points", OnOff(iSettings.GetDragWithEndPts()));
  out.Row("mode", std::to_string(iSettings.GetDragMode()));
  out.Row("elements", OnOff(iSettings.GetDragElts()));

  out.Section("Diagnosis");
  out.Row("show diagnosis", OnOff(iSettings.GetDiagElts()));
  const std::pair<ZEP2DCstDiag, const char*> kinds[] = {{ZEP2DCstOverDefined, "over-defined"},
                                                        {ZEP2DCstNotConsistent, "not consistent"},
                                                        {ZEP2DCstNotChanged, "not changed"},
                                                        {ZEP2DCstWellDefined, "well defined"}};
  for (const auto& [kind, label] : kinds) {
    unsigned int r = 0, g = 0, b = 0;
    iSettings.GetColorDiagElts(kind, &r, &g, &b);
    out.Row(label, Rgb(r, g, b));
  }

  out.Section("Colours");
  unsigned int r = 0, g = 0, b = 0;
  iSettings.GetColorConstructElts(&r, &g, &b);
  out.Row("construction elements", Rgb(r, g, b));
  iSettings.GetColorSmartPick(&r, &g, &b);
  out.Row("smart pick", Rgb(r, g, b));
}

void PrintSketcherSettings(std::ostream& oOut, ZEPAppSettingsFile* iFile) {
  ZEPAppSketcherSettings settings(iFile);
  PrintSketcherSettings(settings, oOut);
}

} // namespace zepapp
