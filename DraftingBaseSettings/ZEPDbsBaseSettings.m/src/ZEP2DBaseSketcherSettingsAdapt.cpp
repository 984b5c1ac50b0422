#include "ZEP2DBaseSketcherSettingsAdapt.h"

#define ZEP_SK_PATH "DraftingBaseSettings/ZEPDbsBaseSettings.m/src/ZEP2DBaseSketcherSettingsAdapt"

const char* const ZEP2DBaseSketcherSettingsAdapt::mstrGridDisplay = "Drw_settings_GridDisplay";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrGridSnapPt = "Drw_settings_GridSnapPt";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrGridHPrSpacing =
    "Drw_settings_GridPrimarySpacing";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrGridHSecStep =
    "Drw_settings_GridSecondaryStep";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrAllowDistortions =
    "Drw_settings_AllowDistortions";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrGridVPrSpacing =
    "Drw_settings_GridVPrimarySpacing";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrGridVSecStep =
    "Drw_settings_GridVSecondaryStep";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrGeomCreateCenter =
    "Drw_settings_CreateCenter";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrCpltPosSupport =
    "Drw_settings_CpltPosSupport";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrCpltPosHorVertTo =
    "Drw_settings_CpltPosHorVertTo";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrCpltDirHorVert =
    "Drw_settings_CpltDirHorVert";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrCpltDirParPerpTan =
    "Drw_settings_CpltDirParPerpTan";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrCpltCreateConstraint = "CstCreation";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrDragWithEndPts =
    "Drw_settings_DragWithEndPts";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrDragMode = "Drw_settings_DragModeR14";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrDragElts = "Drw_settings_DragElts";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrDiagElts = "Drw_settings_DiagElts";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrColorDiagOverDefinedElts =
    "Drw_settings_DiagOverDefinedEltsColor";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrColorDiagNotConsistentElts =
    "Drw_settings_DiagNotConsistentEltsColor";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrColorDiagNotChangedElts =
    "Drw_settings_DiagNotChangedEltsColor";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrColorDiagWellDefinedElts =
    "Drw_settings_DiagWellDefinedEltsColor";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrColorConstructElts =
    "Drw_settings_ConstructEltsColor";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrColorSmartPick =
    "Drw_settings_SmartPickColor";
const char* const ZEP2DBaseSketcherSettingsAdapt::mstrShowPosition = "Drw_settings_ShowPosition";

namespace {
// ---- normalisers: what a setter stores for the value it is given --------------------------------
int Flag(int iValue) { return iValue != 0 ? 1 : 0; }
int DragModeValue(int iValue) { return iValue >= 0 && iValue <= 2 ? iValue : 1; }
// NaN is not greater than zero either and falls back as well.
double Spacing(double iValue) { return iValue > 0.0 ? iValue : 100.0; }
int Step(int iValue) { return iValue > 0 ? iValue : 10; }
// What the sketcher may be handed: a stored spacing of 0 or less, or fewer than one graduation,
// would break its grid, so the getters answer the range's default instead.
bool UsableSpacing(double iValue) { return iValue > 0.0; }
bool UsableStep(int iValue) { return iValue >= 1; }
bool AnyFlag(int) { return true; }

// ---- one int setting ----------------------------------------------------------------------------
int ReadScalar(const ZEPSysSettingRepository* iRep, const char* iName, int iDefault,
               const char* iRepText, const char* iReadCheck) {
  int val = iDefault;
  if (!iRep) {
    Check_Pointer_Failed__(iRepText, ZEP_SK_PATH, __LINE__, nullptr);
    return val;
  }
  if (1 != iRep->ReadAttr(iName, &val, 1))
    Check_TRUE_Failed__(iReadCheck, ZEP_SK_PATH, __LINE__, nullptr);
  return val;
}

// True when written, so that the caller may notify.
bool WriteScalar(ZEPSysSettingRepository* iRep, const char* iName, int iValue, const char* iRepText,
                 const char* iWriteCheck) {
  if (!iRep) {
    Check_Pointer_Failed__(iRepText, ZEP_SK_PATH, __LINE__, nullptr);
    return false;
  }
  if (1 != iRep->WriteAttr(iName, &iValue, 1)) {
    Check_TRUE_Failed__(iWriteCheck, ZEP_SK_PATH, __LINE__, nullptr);
    return false;
  }
  return true;
}

// ---- settings kept per scale range: five values, range k at position k - 1 ----------------------
constexpr double kSpacingDefaults[5] = {100.0, 10000.0, 1000000.0, 1.0, 0.01};
constexpr int kStepDefaults[5] = {10, 10, 10, 10, 10};
constexpr int kDistortionDefaults[5] = {0, 0, 0, 0, 0};

// Ranges outside 1 to 5 use the entry of range 1.
int RangeIndex(ZEPCkeScale iRange) {
  const int range = static_cast<int>(iRange);
  return range >= 1 && range <= 5 ? range - 1 : 0;
}

template <class T>
T ReadRange(const ZEPSysSettingRepository* iRep, const char* iName, const T (&iDefaults)[5],
            T iNoRepository, ZEPCkeScale iRange, bool (*iUsable)(T)) {
  if (!iRep) {
    Check_Pointer_Failed__("_pSpecificSettRep", ZEP_SK_PATH, __LINE__, nullptr);
    return iNoRepository;
  }
  T values[5] = {iDefaults[0], iDefaults[1], iDefaults[2], iDefaults[3], iDefaults[4]};
  // Fewer values than five (an older single-value entry) keep the defaults of the others.
  iRep->ReadAttr(iName, values, 5);
  const int i = RangeIndex(iRange);
  return iUsable(values[i]) ? values[i] : iDefaults[i];
}

// Replaces the entry of one range and writes all five back, so that the others stay as they were.
template <class T>
bool WriteRange(ZEPSysSettingRepository* iRep, const char* iName, const T (&iDefaults)[5], T iValue,
                ZEPCkeScale iRange, const char* iWriteCheck) {
  if (!iRep) {
    Check_Pointer_Failed__("_pSpecificSettRep", ZEP_SK_PATH, __LINE__, nullptr);
    return false;
  }
  T values[5] = {iDefaults[0], iDefaults[1], iDefaults[2], iDefaults[3], iDefaults[4]};
  iRep->ReadAttr(iName, values, 5);
  values[RangeIndex(iRange)] = iValue;
  if (1 != iRep->WriteAttr(iName, values, 5)) {
    Check_TRUE_Failed__(iWriteCheck, ZEP_SK_PATH, __LINE__, nullptr);
    return false;
  }
  return true;
}

// ---- colours: three unsigned ints, red, green, blue ---------------------------------------------
bool OutputsGiven(const unsigned int* iRed, const unsigned int* iGreen, const unsigned int* iBlue) {
  if (iRed && iGreen && iBlue) return true;
  Check_TRUE_Failed__("iRed && iGreen && iBlue", ZEP_SK_PATH, __LINE__, nullptr);
  return false;
}

// The outputs hold the defaults; a complete stored colour replaces them.
void OverlayStoredColor(const ZEPSysSettingRepository* iRep, const char* iName,
                        const char* iRepText, const char* iReadCheck, unsigned int* iRed,
                        unsigned int* iGreen, unsigned int* iBlue) {
  if (!iRep) {
    Check_Pointer_Failed__(iRepText, ZEP_SK_PATH, __LINE__, nullptr);
    return;
  }
  unsigned int tab[3] = {*iRed, *iGreen, *iBlue};
  if (3 != iRep->ReadAttr(iName, tab, 3)) {
    Check_TRUE_Failed__(iReadCheck, ZEP_SK_PATH, __LINE__, nullptr);
    return;
  }
  *iRed = tab[0];
  *iGreen = tab[1];
  *iBlue = tab[2];
}

bool WriteColor(ZEPSysSettingRepository* iRep, const char* iName, const char* iRepText,
                const char* iWriteCheck, unsigned int iRed, unsigned int iGreen,
                unsigned int iBlue) {
  if (!iRep) {
    Check_Pointer_Failed__(iRepText, ZEP_SK_PATH, __LINE__, nullptr);
    return false;
  }
  const unsigned int tab[3] = {iRed, iGreen, iBlue};
  if (1 != iRep->WriteAttr(iName, tab, 3)) {
    Check_TRUE_Failed__(iWriteCheck, ZEP_SK_PATH, __LINE__, nullptr);
    return false;
  }
  return true;
}

// Defaults of the four diagnoses that have a colour setting, ZEP2DCstDiag 1 to 4.
constexpr unsigned int kDiagDefaults[4][3] = {{255, 0, 255}, {255, 0, 0}, {128, 0, 0}, {0, 255, 0}};

// The attribute of a diagnosis, or null for a diagnosis without one.
const char* DiagAttribute(ZEP2DCstDiag iDiag) {
  switch (static_cast<int>(iDiag)) {
  case ZEP2DCstOverDefined:
    return ZEP2DBaseSketcherSettingsAdapt::mstrColorDiagOverDefinedElts;
  case ZEP2DCstNotConsistent:
    return ZEP2DBaseSketcherSettingsAdapt::mstrColorDiagNotConsistentElts;
  case ZEP2DCstNotChanged:
    return ZEP2DBaseSketcherSettingsAdapt::mstrColorDiagNotChangedElts;
  case ZEP2DCstWellDefined:
    return ZEP2DBaseSketcherSettingsAdapt::mstrColorDiagWellDefinedElts;
  default:
    return nullptr;
  }
}
} // namespace

// ---- construction -------------------------------------------------------------------------------
ZEP2DBaseSketcherSettingsAdapt::ZEP2DBaseSketcherSettingsAdapt() = default;

ZEP2DBaseSketcherSettingsAdapt::~ZEP2DBaseSketcherSettingsAdapt() {
  _pSettRep = nullptr;
  _pSpecificSettRep = nullptr;
}

// ---- int settings, one row each: getter and setter stem, attribute, repository, read default,
// normaliser, dispatcher. The check texts are built from the same tokens the code uses.
#define ZEP_SK_INT_SETTINGS(X)                                                                     \
  X(GridVisuMode, mstrGridDisplay, _pSpecificSettRep, 1, Flag, GridModify)                         \
  X(GridSnapMode, mstrGridSnapPt, _pSpecificSettRep, 1, Flag, SnapModify)                          \
  X(CreateCenter, mstrGeomCreateCenter, _pSettRep, 1, Flag, GeomUIModify)                          \
  X(PosSupports, mstrCpltPosSupport, _pSettRep, 1, Flag, CpltModify)                               \
  X(PosHorVertTo, mstrCpltPosHorVertTo, _pSettRep, 1, Flag, CpltModify)                            \
  X(DirHorVert, mstrCpltDirHorVert, _pSettRep, 1, Flag, CpltModify)                                \
  X(DirParaPerpTan, mstrCpltDirParPerpTan, _pSettRep, 1, Flag, CpltModify)                         \
  X(DragWithEndPts, mstrDragWithEndPts, _pSettRep, 1, Flag, GeomUIModify)                          \
  X(DragMode, mstrDragMode, _pSettRep, 1, DragModeValue, GeomUIModify)                             \
  X(DragElts, mstrDragElts, _pSettRep, 1, Flag, GeomUIModify)                                      \
  X(DiagElts, mstrDiagElts, _pSpecificSettRep, 1, Flag, GeomUIModify)                              \
  X(ShowPosition, mstrShowPosition, _pSettRep, 0, Flag, CpltModify)

#define ZEP_SK_DEFINE_INT(Stem, Name, Rep, Default, Normalise, Dispatch)                           \
  int ZEP2DBaseSketcherSettingsAdapt::Get##Stem() {                                                \
    return ReadScalar(Rep, Name, Default, #Rep, "1==" #Rep "->ReadAttr(" #Name ", &val)");         \
  }                                                                                                \
  void ZEP2DBaseSketcherSettingsAdapt::Set##Stem(int iValue, int iNotify) {                        \
    if (WriteScalar(Rep, Name, Normalise(iValue), #Rep,                                            \
                    "1==" #Rep "->WriteAttr(" #Name ", &val)") &&                                  \
        iNotify)                                                                                   \
      Dispatch();                                                                                  \
  }
ZEP_SK_INT_SETTINGS(ZEP_SK_DEFINE_INT)
#undef ZEP_SK_DEFINE_INT

// ---- per-range settings: stem, value type, attribute, written buffer (for the check text),
// defaults, value without a repository, normaliser, test of a stored value. All live in the
// specific repository and notify a grid change.
#define ZEP_SK_RANGE_SETTINGS(X)                                                                   \
  X(GridPrimSpac, double, mstrGridHPrSpacing, gridSpacingH, kSpacingDefaults, 100.0, Spacing,      \
    UsableSpacing)                                                                                 \
  X(GridSecStep, int, mstrGridHSecStep, gridStepH, kStepDefaults, 10, Step, UsableStep)            \
  X(AllowDistortions, int, mstrAllowDistortions, allowDistortions, kDistortionDefaults, 0, Flag,   \
    AnyFlag)                                                                                       \
  X(GridVPrimSpac, double, mstrGridVPrSpacing, gridSpacingV, kSpacingDefaults, 100.0, Spacing,     \
    UsableSpacing)                                                                                 \
  X(GridVSecStep, int, mstrGridVSecStep, gridStepV, kStepDefaults, 10, Step, UsableStep)

#define ZEP_SK_DEFINE_RANGE(Stem, T, Name, Buffer, Defaults, NoRepository, Normalise, Usable)      \
  T ZEP2DBaseSketcherSettingsAdapt::Get##Stem(ZEPCkeScale iRange) {                                \
    return ReadRange<T>(_pSpecificSettRep, Name, Defaults, NoRepository, iRange, Usable);          \
  }                                                                                                \
  void ZEP2DBaseSketcherSettingsAdapt::Set##Stem(T iValue, int iNotify, ZEPCkeScale iRange) {      \
    if (WriteRange<T>(_pSpecificSettRep, Name, Defaults, Normalise(iValue), iRange,                \
                      "1==_pSpecificSettRep->WriteAttr(" #Name ", &" #Buffer ")") &&               \
        iNotify)                                                                                   \
      GridModify();                                                                                \
  }
ZEP_SK_RANGE_SETTINGS(ZEP_SK_DEFINE_RANGE)
#undef ZEP_SK_DEFINE_RANGE

// ---- constraint creation ------------------------------------------------------------------------
int ZEP2DBaseSketcherSettingsAdapt::GetCreateConstraint() {
  // Each is asked, in this order, before deciding, so overrides see the same calls whatever
  // the values.
  const int posSupports = GetPosSupports();
  const int posHorVertTo = GetPosHorVertTo();
  const int dirHorVert = GetDirHorVert();
  const int dirParaPerpTan = GetDirParaPerpTan();
  if (!posSupports && !posHorVertTo && !dirHorVert && !dirParaPerpTan) return 0;
  return ReadScalar(_pSettRep, mstrCpltCreateConstraint, 0, "_pSettRep",
                    "1==_pSettRep->ReadAttr(\"CstCreation\", &val)");
}

void ZEP2DBaseSketcherSettingsAdapt::SetCreateConstraint(int iValue, int iNotify) {
  if (WriteScalar(_pSettRep, mstrCpltCreateConstraint, Flag(iValue), "_pSettRep",
                  "1==_pSettRep->WriteAttr(mstrCpltCreateConstraint, &val)") &&
      iNotify)
    CpltModify();
}

int ZEP2DBaseSketcherSettingsAdapt::GetValidateConstraint() { return GetCreateConstraint(); }
void ZEP2DBaseSketcherSettingsAdapt::SetValidateConstraint(int iValue, int iNotify) {
  SetCreateConstraint(iValue, iNotify);
}

int ZEP2DBaseSketcherSettingsAdapt::GetValidateCstType(ZEP2DCstType iType) {
  // Compared as unsigned: negative types are unknown types and validate like them.
  switch (static_cast<unsigned int>(iType)) {
  case 1u:
  case 2u:
  case 4u:
  case 10u:
    return 0;
  default:
    return 1;
  }
}

// The parallel, perpendicular and tangent directions share one setting.
int ZEP2DBaseSketcherSettingsAdapt::GetDirParallel() { return GetDirParaPerpTan(); }
int ZEP2DBaseSketcherSettingsAdapt::GetDirPerpend() { return GetDirParaPerpTan(); }
int ZEP2DBaseSketcherSettingsAdapt::GetDirTangent() { return GetDirParaPerpTan(); }
void ZEP2DBaseSketcherSettingsAdapt::SetDirParallel(int iValue, int iNotify) {
  SetDirParaPerpTan(iValue, iNotify);
}
void ZEP2DBaseSketcherSettingsAdapt::SetDirPerpend(int iValue, int iNotify) {
  SetDirParaPerpTan(iValue, iNotify);
}
void ZEP2DBaseSketcherSettingsAdapt::SetDirTangent(int iValue, int iNotify) {
  SetDirParaPerpTan(iValue, iNotify);
}

// ---- settings drafting does not offer: fixed answers, writes ignored ----------------------------
int ZEP2DBaseSketcherSettingsAdapt::GetGridGroundMode() { return 0; }
int ZEP2DBaseSketcherSettingsAdapt::GetAnimate() { return 1; }
int ZEP2DBaseSketcherSettingsAdapt::GetShowPositionOnCursor() { return 1; }
int ZEP2DBaseSketcherSettingsAdapt::GetViewNormalTo() { return 1; }
void ZEP2DBaseSketcherSettingsAdapt::SetGridGroundMode(int, int) {}
void ZEP2DBaseSketcherSettingsAdapt::SetAnimate(int, int) {}
void ZEP2DBaseSketcherSettingsAdapt::SetShowPositionOnCursor(int, int) {}
void ZEP2DBaseSketcherSettingsAdapt::SetViewNormalTo(int, int) {}
void ZEP2DBaseSketcherSettingsAdapt::GetColorIsolatedElts(unsigned int*, unsigned int*,
                                                          unsigned int*) {}
void ZEP2DBaseSketcherSettingsAdapt::GetColorProtectedElts(unsigned int*, unsigned int*,
                                                           unsigned int*) {}
void ZEP2DBaseSketcherSettingsAdapt::SetColorIsolatedElts(unsigned int, unsigned int, unsigned int,
                                                          int) {}
void ZEP2DBaseSketcherSettingsAdapt::SetColorProtectedElts(unsigned int, unsigned int, unsigned int,
                                                           int) {}

// ---- colours ------------------------------------------------------------------------------------
void ZEP2DBaseSketcherSettingsAdapt::GetRGB(unsigned int iPacked, unsigned int* iRed,
                                            unsigned int* iGreen, unsigned int* iBlue) {
  if (!iRed || !iGreen || !iBlue) return;
  *iRed = (iPacked >> 16) & 0xFFu;
  *iGreen = (iPacked >> 8) & 0xFFu;
  *iBlue = iPacked & 0xFFu;
}

void ZEP2DBaseSketcherSettingsAdapt::SetRGB(unsigned int* iPacked, unsigned int iRed,
                                            unsigned int iGreen, unsigned int iBlue) {
  if (iPacked) *iPacked = (((iRed << 8) | iGreen) << 8) | iBlue;
}

void ZEP2DBaseSketcherSettingsAdapt::GetColorDiagElts(ZEP2DCstDiag iDiag, unsigned int* iRed,
                                                      unsigned int* iGreen, unsigned int* iBlue) {
  if (!OutputsGiven(iRed, iGreen, iBlue)) return;
  unsigned int packed = GetDefaultColorDiagElts(iDiag);
  const char* pName = DiagAttribute(iDiag);
  if (pName) {
    const unsigned int* rgb = kDiagDefaults[static_cast<int>(iDiag) - 1];
    SetRGB(&packed, rgb[0], rgb[1], rgb[2]);
  }
  GetRGB(packed, iRed, iGreen, iBlue);
  if (!pName) return;
  OverlayStoredColor(_pSpecificSettRep, pName, "_pSpecificSettRep",
                     "3==_pSpecificSettRep->ReadAttr(pName, tab, 3)", iRed, iGreen, iBlue);
}

void ZEP2DBaseSketcherSettingsAdapt::SetColorDiagElts(ZEP2DCstDiag iDiag, unsigned int iRed,
                                                      unsigned int iGreen, unsigned int iBlue,
                                                      int iNotify) {
  // A diagnosis without a setting writes nothing but still notifies when asked.
  const char* pName = DiagAttribute(iDiag);
  if (pName && !WriteColor(_pSpecificSettRep, pName, "_pSpecificSettRep",
                           "1 ==_pSpecificSettRep->WriteAttr(pName, tab, 3)", iRed, iGreen, iBlue))
    return;
  if (iNotify) GeomUIModify();
}

// The general colours: stem, attribute, default red, green, blue. Both notify a geometry change.
#define ZEP_SK_COLOR_SETTINGS(X)                                                                   \
  X(ColorConstructElts, mstrColorConstructElts, 140, 140, 140)                                     \
  X(ColorSmartPick, mstrColorSmartPick, 67, 102, 85)

#define ZEP_SK_DEFINE_COLOR(Stem, Name, Red, Green, Blue)                                          \
  void ZEP2DBaseSketcherSettingsAdapt::Get##Stem(unsigned int* iRed, unsigned int* iGreen,         \
                                                 unsigned int* iBlue) {                            \
    if (!OutputsGiven(iRed, iGreen, iBlue)) return;                                                \
    *iRed = Red;                                                                                   \
    *iGreen = Green;                                                                               \
    *iBlue = Blue;                                                                                 \
    OverlayStoredColor(_pSettRep, Name, "_pSettRep", "3==_pSettRep->ReadAttr(" #Name ", tab, 3)",  \
                       iRed, iGreen, iBlue);                                                       \
  }                                                                                                \
  void ZEP2DBaseSketcherSettingsAdapt::Set##Stem(unsigned int iRed, unsigned int iGreen,           \
                                                 unsigned int iBlue, int iNotify) {                \
    if (WriteColor(_pSettRep, Name, "_pSettRep", "1==_pSettRep->WriteAttr(" #Name ", tab, 3)",     \
                   iRed, iGreen, iBlue) &&                                                         \
        iNotify)                                                                                   \
      GeomUIModify();                                                                              \
  }
ZEP_SK_COLOR_SETTINGS(ZEP_SK_DEFINE_COLOR)
#undef ZEP_SK_DEFINE_COLOR

// ---- saving -------------------------------------------------------------------------------------
long ZEP2DBaseSketcherSettingsAdapt::SaveRepository() {
  if (!_pSettRep) {
    Check_Pointer_Failed__("_pSettRep", ZEP_SK_PATH, __LINE__, nullptr);
    return E_FAIL;
  }
  if (!_pSpecificSettRep) {
    Check_Pointer_Failed__("_pSpecificSettRep", ZEP_SK_PATH, __LINE__, nullptr);
    return E_FAIL;
  }
  if (!SUCCEEDED(_pSettRep->SaveRepository())) {
    Check_TRUE_Failed__("SUCCEEDED(_pSettRep->SaveRepository())", ZEP_SK_PATH, __LINE__, nullptr);
    return E_FAIL;
  }
  if (!SUCCEEDED(_pSpecificSettRep->SaveRepository())) {
    Check_TRUE_Failed__("SUCCEEDED(_pSpecificSettRep->SaveRepository())", ZEP_SK_PATH, __LINE__,
                        nullptr);
    return E_FAIL;
  }
  return S_OK;
}

// ---- notifications: no notification object, the adapter as data ---------------------------------
void ZEP2DBaseSketcherSettingsAdapt::DispatchMultiModify() {
  DispatchCallbacks(ZEPSketcherSettings::MultiModification(), nullptr, this);
}
void ZEP2DBaseSketcherSettingsAdapt::GridModify() {
  DispatchCallbacks(ZEPSketcherSettings::GridModification(), nullptr, this);
}
void ZEP2DBaseSketcherSettingsAdapt::GeomUIModify() {
  DispatchCallbacks(ZEPSketcherSettings::GeomUIModification(), nullptr, this);
}
void ZEP2DBaseSketcherSettingsAdapt::SnapModify() {
  DispatchCallbacks(ZEPSketcherSettings::SnapModification(), nullptr, this);
}
void ZEP2DBaseSketcherSettingsAdapt::Visu3DUIModify() {
  DispatchCallbacks(ZEPSketcherSettings::Visu3DUIModification(), nullptr, this);
}
void ZEP2DBaseSketcherSettingsAdapt::CpltModify() {
  DispatchCallbacks(ZEPSketcherSettings::CpltModification(), nullptr, this);
}
