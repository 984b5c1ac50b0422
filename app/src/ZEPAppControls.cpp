#include "ZEPAppControls.h"

#include "ZEPAppBinding.h"
#include "ZEP2DBaseRangeCmb.h"
#include "ZEPDrwLockDialog.h"
#include "ZEPDrwLockFrame.h"
#include "ZEPDrwLockLabel.h"

#include <algorithm>
#include <cctype>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <filesystem>

namespace zepapp {

namespace {

std::string Lower(std::string s) {
  for (char& c : s)
    c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
  return s;
}

std::string Trim(const std::string& s) {
  const auto first = s.find_first_not_of(" \t");
  if (first == std::string::npos) return "";
  return s.substr(first, s.find_last_not_of(" \t") - first + 1);
}

std::string Quoted(const std::string& s) { return "\"" + s + "\""; }

// The combo the user picks lines in, as the driver sees it.
ZEPDlgCombo* PickableCombo(ZEPDialog* iWidget) {
  if (auto* combo = ZEPSysDynamicCast<ZEPDlgCombo>(iWidget)) return combo;
  if (auto* numbered = ZEPSysDynamicCast<ZEPNumberedCombo>(iWidget)) return numbered->GetCombo();
  if (auto* colour = ZEPSysDynamicCast<ZEPComboColor>(iWidget)) return colour->GetCombo();
  return nullptr;
}

std::vector<std::string> Lines(const ZEPDlgCombo& iCombo) {
  std::vector<std::string> lines;
  for (int i = 0; i < iCombo.GetLineCount(); ++i) {
    ZEPUnicodeString text;
    iCombo.GetLine(text, i);
    lines.push_back(text.str());
  }
  return lines;
}

// Toolkit units (the numbering of the settings services) and what the user may type for them.
enum class Magnitude { None, Length, Angle };
struct UnitWord {
  const char* word;
  ZEPDlgUnit unit;
};
const UnitWord kUnitWords[] = {
    {"mm", 45},          {"millimetre", 45},  {"millimetres", 45}, {"millimeter", 45},
    {"millimeters", 45}, {"cm", 46},          {"centimetre", 46},  {"centimetres", 46},
    {"centimeter", 46},  {"centimeters", 46}, {"m", 43},           {"metre", 43},
    {"metres", 43},      {"meter", 43},       {"meters", 43},      {"km", 47},
    {"um", 44},          {"\xC2\xB5m", 44},   {"micron", 44},      {"microns", 44},
    {"in", 48},          {"inch", 48},        {"inches", 48},      {"\"", 48},
    {"ft", 49},          {"foot", 49},        {"feet", 49},        {"'", 49},
    {"deg", 12},         {"degree", 12},      {"degrees", 12},     {"\xC2\xB0", 12},
    {"rad", 11},         {"radian", 11},      {"radians", 11},     {"gr", 15},
    {"grad", 15},        {"grade", 15},       {"grades", 15},      {"gon", 15},
};
// The short forms listed in messages.
const char* const kLengthWords = "mm, cm, m, km, in, ft";
const char* const kAngleWords = "deg, rad, gr";

Magnitude MagnitudeOf(ZEPDlgUnit iUnit) {
  if (iUnit >= 43 && iUnit <= 52) return Magnitude::Length;
  if (iUnit == 11 || iUnit == 12 || iUnit == 15) return Magnitude::Angle;
  return Magnitude::None;
}

bool IsWhole(double v) { return std::fabs(v - std::round(v)) < 1e-9; }

// A count spinner (no unit) whose limits and step are whole numbers takes whole numbers only.
bool TakesWholeNumbers(const ZEPDlgSpinner& s) {
  if (MagnitudeOf(s.GetUnit()) != Magnitude::None) return false;
  double lo = 0, hi = 0, step = 1;
  s.GetMinMaxStep(lo, hi, step);
  return !s.HasLimits() || (IsWhole(lo) && IsWhole(hi) && IsWhole(step));
}

// The spinner's value in its display unit, in the fewest digits that read back to the very same
// value: typing what is shown never changes a setting.
std::string ExactValue(const ZEPDlgSpinner& iSpinner) {
  const double internal = iSpinner.GetValue();
  const double shown = iSpinner.ToDisplay(internal);
  // Plain decimals for the sizes people type, the exponent form beyond them.
  const bool plain = shown == 0 || (std::fabs(shown) >= 1e-5 && std::fabs(shown) < 1e15);
  std::string text;
  for (int digits = plain ? 0 : 1; digits <= (plain ? 20 : 17); ++digits) {
    char buffer[64];
    std::snprintf(buffer, sizeof buffer, plain ? "%.*f" : "%.*g", digits, shown);
    text = buffer;
    if (iSpinner.FromDisplay(std::strtod(buffer, nullptr)) == internal) break;
  }
  if (text == "-0") text = "0";
  const std::string symbol = iSpinner.UnitSymbol();
  return symbol.empty() ? text : text + " " + symbol;
}

// Length of the number at the start of s ("-2.5e3"); 0 when it does not start with one.
std::size_t NumberLength(const std::string& s) {
  std::size_t i = 0;
  auto digits = [&] {
    std::size_t from = i;
    while (i < s.size() && std::isdigit(static_cast<unsigned char>(s[i])))
      ++i;
    return i - from;
  };
  if (i < s.size() && (s[i] == '+' || s[i] == '-')) ++i;
  std::size_t mantissa = digits();
  if (i < s.size() && s[i] == '.') {
    ++i;
    mantissa += digits();
  }
  if (mantissa == 0) return 0;
  if (i < s.size() && (s[i] == 'e' || s[i] == 'E')) {
    std::size_t mark = i++;
    if (i < s.size() && (s[i] == '+' || s[i] == '-')) ++i;
    if (digits() == 0) i = mark; // "2e" is 2 followed by something else
  }
  return i;
}

const ZEPAppControl* ByName(const std::vector<ZEPAppControl>& iControls, const std::string& iName) {
  for (const ZEPAppControl& c : iControls)
    if (c.name == iName) return &c;
  return nullptr;
}

const ZEPAppControl* RangeControl(const std::vector<ZEPAppControl>& iControls) {
  for (const ZEPAppControl& c : iControls)
    if (dynamic_cast<ZEP2DBaseRangeCmb*>(c.widget)) return &c;
  return nullptr;
}

// Controls that their page enables only while a check button is on (or only while it is off);
// perRange: that check button holds one value per scale range.
struct Dependency {
  const char* control;
  const char* needs;
  bool whileOn;
  bool perRange;
};
const Dependency kDependencies[] = {
    {"editorGridSpacingV", "checkAllowDistortions", true, true},
    {"editorGridGraduationV", "checkAllowDistortions", true, true},
    {"dragOptionPushButton", "checkGeomDrag", true, false},
    {"editorCstRefSize", "checkCstVisu", true, false},
    {"comboCstColor", "checkCstVisu", true, false},
    {"cstTypesPushButton", "checkCstVisu", true, false},
    {"editorDimLinePosValue", "checkDimSketch", false, false},
    {"checkLineUpAutoFunnel", "checkLineUpCumulVal", true, false},
    {"checkAnnotInSpecTreeAnnotSet", "checkAnnotInSpecTreePlane", true, false},
    {"diagElementsColorsPushButton", "checkDesignMode", true, false},
    {"diagGeometriesColorsPushButton", "checkVisualizationDiag", true, false},
    {"cmbPatternContourPitch", "chkPatternContourPitch", true, false},
#define ZEP_APP_STATE_DEPENDENCY(Name) {"cmb" #Name, "chk" #Name, true, false},
    ZEP_APP_STATE_DEPENDENCY(AnnotDelGeom) ZEP_APP_STATE_DEPENDENCY(AnnotUnloadGeom)
    ZEP_APP_STATE_DEPENDENCY(AnnotInvalid) ZEP_APP_STATE_DEPENDENCY(DimNotUpToDate)
    ZEP_APP_STATE_DEPENDENCY(DimNonAssoc) ZEP_APP_STATE_DEPENDENCY(DimIsolated)
    ZEP_APP_STATE_DEPENDENCY(DimBroken) ZEP_APP_STATE_DEPENDENCY(DimFake)
    ZEP_APP_STATE_DEPENDENCY(DimDriving) ZEP_APP_STATE_DEPENDENCY(Dim3DCst)
    ZEP_APP_STATE_DEPENDENCY(TechFeatDim) ZEP_APP_STATE_DEPENDENCY(DimTrue)
    ZEP_APP_STATE_DEPENDENCY(DimOnNonVisGeom) ZEP_APP_STATE_DEPENDENCY(DimClipped)
    ZEP_APP_STATE_DEPENDENCY(FilterGeneratedElements)
    ZEP_APP_STATE_DEPENDENCY(CalloutLastUpdateFailed) ZEP_APP_STATE_DEPENDENCY(IsolatedCallout)
    ZEP_APP_STATE_DEPENDENCY(NotPerpendicularCallout) ZEP_APP_STATE_DEPENDENCY(DrwWeldNotUpToDate)
#undef ZEP_APP_STATE_DEPENDENCY
    {"chkMakeDrawingShareable", "chkInsertDrawing", true, false},
    {"chkGVSParamOverride", "chkPreventGVS", false, false},
    {"chkPrevViewGeomUpgrade", "chkPreventViewUpgrade", false, false},
    {"frmViewNameUnicityScope", "checkViewNamesUnicity", true, false},
    {"chkShowWarningSelectionOutFavoriteContext", "chkShowWarningSelectionOutAssembly", false,
     false},
};

// Controls that need at least one of several check buttons on.
struct AnyOf {
  const char* control;
  std::vector<const char*> needs;
};
const AnyOf kAnyOf[] = {
    {"chkDistinguishCodeInUnicity",
     {"checkSheetNamesUnicity", "checkViewNamesUnicity", "checkFilterNamesUnicity",
      "chkCaptureNamesUnicity"}},
    {"chkDistinguishCaseInUnicity",
     {"checkSheetNamesUnicity", "checkViewNamesUnicity", "checkFilterNamesUnicity",
      "chkCaptureNamesUnicity"}},
};

// Controls enabled only while a choice (radio group) shows one of some choices, by position.
struct ChoiceRule {
  const char* control;
  const char* choice;
  std::vector<int> allowed;
};
const ChoiceRule kChoiceRules[] = {
    {"chkShowWarningSelectionOutAssembly", "frmSelectionOnCurrentAssembly", {1, 2}},
    {"chkShowWarningSelectionOutFavoriteContext", "frmSelectionOnCurrentAssembly", {2}},
};

// Buttons that open a dialog of the newer framework, which the command line opens and ends.
const char* const kNewerDialogButtons[] = {"pushTableSortCustomLists", "pushLegendTableLayout"};

// The radio buttons of a group frame, in screen order.
std::vector<ZEPDlgRadioButton*> Radios(ZEPDialog* iGroup) {
  std::vector<ZEPDlgRadioButton*> radios;
  if (iGroup)
    for (ZEPDialog* child : iGroup->GetChildren())
      if (auto* radio = ZEPSysDynamicCast<ZEPDlgRadioButton>(child)) radios.push_back(radio);
  return radios;
}

// A check button of a matrix has no text of its own: its row's text label (column 1 of its
// row) and its column's header (row 0 of its column) name it.
std::string MatrixTitle(const ZEPDialog& iCell) {
  const ZEPDialog* grid = iCell.GetParentDialog();
  if (!grid) return "";
  const ZEPDialog::Cell& at = iCell.GetGridConstraints();
  std::string row, column;
  for (const ZEPDialog* w : grid->GetChildren()) {
    if (std::string(w->KindName()) != "label" || w->GetTitle().IsEmpty()) continue;
    const ZEPDialog::Cell& c = w->GetGridConstraints();
    if (at.row > 0 && c.row == at.row && c.column == 1) row = w->GetTitle().str();
    if (c.row == 0 && c.column == at.column) column = w->GetTitle().str();
  }
  return row.empty() || column.empty() ? "" : row + " / " + column;
}

std::string TitleOf(const ZEPDialog& w) {
  return w.GetTitle().IsEmpty() ? w.GetOwnName() : w.GetTitle().str();
}

// What the user picks from: a combo's lines, or the texts of a group's radio buttons.
std::vector<std::string> Choices(const ZEPAppControl& iControl) {
  if (const ZEPDlgCombo* combo = PickableCombo(iControl.inner)) return Lines(*combo);
  std::vector<std::string> texts;
  for (ZEPDlgRadioButton* radio : Radios(iControl.inner))
    texts.push_back(TitleOf(*radio));
  return texts;
}

// ---- the main page's standards and scale ratio ---------------------------------------------------
// The controls that need more than a line, a number or a text: the standard combo (its PLM lines
// carry keys), the PLM chooser's buttons, the scale ratio editor and the folder editors.
const char* const kStandardCombo = "cmbStandardName";
const char* const kAddPLMStandard = "pusStandardPLMAdd";
const char* const kRemovePLMStandard = "pusStandardPLMRemove";
const char* const kRatioEditor = "edtScaleRatio";
const char* const kFolderEditors[] = {"FrameAndTitleBlockPath"};
const char* const kDatabaseIcon = "I_D3M_Database";

// The texts a repository reads for a row of the main page's table; empty when none.
std::vector<std::string> StoredTexts(const char* iAttribute) {
  std::vector<std::string> texts;
  if (const ZEPAppSetting* s = FindSetting("Main", iAttribute))
    if (const ZEPSysSettingRepository* rep = ZEPSysSettingRepository::GetRepository(s->repository.c_str()))
      rep->ReadAttr(s->stored.c_str(), texts);
  return texts;
}

struct StandardLine {
  std::string text;
  std::string key; // a PLM line's unique key; empty for a folder standard
};

// The standard combo's lines, each PLM line with its key. The PLM lines are the combo's last
// lines, in the order of the stored lists.
std::vector<StandardLine> StandardLines(const ZEPDlgCombo& iCombo) {
  const std::vector<std::string> keys = StoredTexts("StandardPLMIDList");
  std::vector<StandardLine> lines;
  for (int i = 0; i < iCombo.GetLineCount(); ++i) {
    ZEPUnicodeString text;
    iCombo.GetLine(text, i);
    lines.push_back({text.str(), ""});
  }
  const int firstPLM = iCombo.GetLineCount() - static_cast<int>(keys.size());
  for (int i = std::max(firstPLM, 0); i < iCombo.GetLineCount(); ++i) {
    ZEPString icon;
    iCombo.GetLineIconName(icon, i);
    if (icon != kDatabaseIcon) return lines; // the lists and the combo disagree: no keys
  }
  for (int i = std::max(firstPLM, 0); i < iCombo.GetLineCount(); ++i)
    lines[static_cast<std::size_t>(i)].key = keys[static_cast<std::size_t>(i - firstPLM)];
  return lines;
}

// The tolerance bounds of the scale ratio at a range (1 to 5); false when the host's
// tolerances give none.
bool RatioBounds(int iRange, double& oLow, double& oHigh) {
  const ZEPDibTolerances tolerances(ZEP2DBaseRangeCmb::GetMatchingRange(iRange >= 1 && iRange <= 5 ? iRange : 1));
  const double largest = tolerances.GetTolerance(7), smallest = tolerances.GetTolerance(6);
  if (!std::isfinite(largest) || !std::isfinite(smallest) || largest <= 0.0 || smallest <= 0.0) return false;
  oLow = 1.0 / largest;
  oHigh = 1.0 / smallest;
  return true;
}

// The range the scale range combo beside the ratio editor shows; 1 when there is none.
int RangeBeside(const ZEPDialog* iEditor) {
  const ZEPDialog* parent = iEditor ? iEditor->GetParentDialog() : nullptr;
  if (parent)
    for (const ZEPDialog* child : parent->GetChildren())
      if (const auto* range = dynamic_cast<const ZEP2DBaseRangeCmb*>(child)) {
        const int r = range->GetSelect();
        if (r >= 1 && r <= 5) return r;
      }
  return 1;
}

std::string Number(double iValue) {
  char text[32];
  std::snprintf(text, sizeof text, "%g", iValue);
  return text;
}

void Walk(ZEPDialog* iWidget, std::string iSection, std::vector<ZEPAppControl>& oControls) {
  if (ZEPSysDynamicCast<ZEPDlgWindow>(iWidget)) return; // a sub-dialog: listed after the page
  if (auto* section = ZEPSysDynamicCast<ZEPDlgToolsOptionsFrame>(iWidget))
    iSection = section->GetTitle().str();
  if (auto* lockAware = dynamic_cast<ZEPDrwLockDialog*>(iWidget)) {
    ZEPDialog* inner = lockAware->GetDialog();
    // A padlocked frame without radio buttons only puts its controls under one padlock (the
    // main page's scale ratio): they are the controls, each with that padlock.
    if (inner && dynamic_cast<ZEPDrwLockFrame*>(iWidget) && Radios(inner).empty()) {
      const std::size_t first = oControls.size();
      for (ZEPDialog* child : inner->GetChildren())
        Walk(child, iSection, oControls);
      for (std::size_t i = first; i < oControls.size(); ++i)
        if (!oControls[i].lockAware) oControls[i].lockAware = lockAware;
      return;
    }
    if (inner) oControls.push_back({iWidget->GetOwnName(), iWidget, inner, lockAware, iSection});
    // A padlocked group may hold controls of their own beside its radio buttons.
    if (inner && dynamic_cast<ZEPDrwLockFrame*>(iWidget))
      for (ZEPDialog* child : inner->GetChildren())
        if (!ZEPSysDynamicCast<ZEPDlgRadioButton>(child)) Walk(child, iSection, oControls);
    return;
  }
  if (dynamic_cast<ZEPDrwLockLabel*>(iWidget)) return; // a caption
  const bool operable = PickableCombo(iWidget) || ZEPSysDynamicCast<ZEPDlgSpinner>(iWidget) ||
                        ZEPSysDynamicCast<ZEPDlgCheckButton>(iWidget) ||
                        ZEPSysDynamicCast<ZEPDlgPushButton>(iWidget) ||
                        ZEPSysDynamicCast<ZEPDlgEditor>(iWidget);
  if (operable) {
    if (iWidget->GetVisibility() != ZEPDlgHide)
      oControls.push_back({iWidget->GetOwnName(), iWidget, iWidget, nullptr, iSection});
    return;
  }
  for (ZEPDialog* child : iWidget->GetChildren())
    Walk(child, iSection, oControls);
}

} // namespace

// ---- one control ------------------------------------------------------------------------------
ZEPAppKind ZEPAppControl::Kind() const {
  if (ZEPSysDynamicCast<ZEPDlgCheckButton>(inner)) return ZEPAppKind::Check;
  if (ZEPSysDynamicCast<ZEPDlgSpinner>(inner)) return ZEPAppKind::Spinner;
  if (PickableCombo(inner)) return ZEPAppKind::Combo;
  if (ZEPSysDynamicCast<ZEPDlgPushButton>(inner)) return ZEPAppKind::Push;
  if (ZEPSysDynamicCast<ZEPDlgEditor>(inner)) return ZEPAppKind::Editor;
  if (!Radios(inner).empty()) return ZEPAppKind::Choice;
  return ZEPAppKind::Other;
}

std::string ZEPAppControl::Title() const {
  if (!inner->GetTitle().IsEmpty()) return inner->GetTitle().str();
  if (!widget->GetTitle().IsEmpty()) return widget->GetTitle().str();
  const std::string matrix = MatrixTitle(*widget);
  return matrix.empty() ? name : matrix;
}

std::string ZEPAppControl::Shown() const {
  switch (Kind()) {
  case ZEPAppKind::Check:
    return ZEPSysDynamicCast<ZEPDlgCheckButton>(inner)->GetState() == ZEPDlgChecked ? "on" : "off";
  case ZEPAppKind::Spinner:
    return ExactValue(*ZEPSysDynamicCast<ZEPDlgSpinner>(inner));
  case ZEPAppKind::Combo: {
    const ZEPDlgCombo* combo = PickableCombo(inner);
    ZEPUnicodeString text;
    if (combo->GetLine(text, combo->GetSelect()) >= 0) return text.str();
    // The current standard in neither list: the page shows it as a first line it does not select.
    const std::vector<std::string> current = name == kStandardCombo ? StoredTexts("StandardName") : std::vector<std::string>();
    if (!current.empty() && combo->GetLine(text, 0) >= 0 && text.str() == current.front())
      return text.str() + " (not offered)";
    return "(none)";
  }
  case ZEPAppKind::Choice:
    for (ZEPDlgRadioButton* radio : Radios(inner))
      if (radio->GetState() == ZEPDlgChecked) return TitleOf(*radio);
    return "(none)";
  case ZEPAppKind::Editor:
    return ZEPSysDynamicCast<ZEPDlgEditor>(inner)->GetText().str();
  case ZEPAppKind::Push:
  case ZEPAppKind::Other:
    break;
  }
  return "";
}

bool ZEPAppControl::Locked() const {
  return lockAware && lockAware->GetLock() && lockAware->GetLock()->IsLocked();
}

std::string ZEPAppControl::LockText() const {
  if (!Locked()) return "";
  const std::string& text = lockAware->GetLock()->GetLockText();
  return text.empty() ? "Locked by an administrator" : text;
}

bool ZEPAppControl::Disabled() const { return !inner->IsEffectivelyEnabled(); }

std::string ZEPAppControl::Accepts() const {
  switch (Kind()) {
  case ZEPAppKind::Check:
    return "on or off";
  case ZEPAppKind::Spinner: {
    const auto* s = ZEPSysDynamicCast<ZEPDlgSpinner>(inner);
    double lo = 0, hi = 0, step = 0;
    s->GetMinMaxStep(lo, hi, step);
    const Magnitude m = MagnitudeOf(s->GetUnit());
    if (m == Magnitude::None) {
      const std::string what = TakesWholeNumbers(*s) ? "a whole number" : "a number";
      return s->HasLimits() ? what + " from " + s->FormatValue(lo) + " to " + s->FormatValue(hi)
                            : what;
    }
    std::string text = m == Magnitude::Length ? "a length" : "an angle";
    if (s->HasLimits()) text += " from " + s->FormatValue(lo) + " to " + s->FormatValue(hi);
    text += ", in " + s->UnitSymbol() + " or with a unit (" +
            (m == Magnitude::Length ? kLengthWords : kAngleWords) + ")";
    return text;
  }
  case ZEPAppKind::Combo:
  case ZEPAppKind::Choice: {
    const std::vector<std::string> lines = Choices(*this);
    if (ZEPSysDynamicCast<ZEPComboColor>(inner)) {
      std::string text = "a colour as \"R G B\" (0 to 255 each) or #RRGGBB, or one of its lines:";
      for (std::size_t i = 0; i < lines.size(); ++i)
        text += "\n  " + std::to_string(i + 1) + "  " + lines[i];
      return text;
    }
    const char* what = Kind() == ZEPAppKind::Combo ? "line" : "choice";
    std::string text = std::string("a ") + what + " number from 1 to " +
                       std::to_string(lines.size()) + " or the text of a " + what;
    if (name == kStandardCombo) text += ", or a PLM standard's key";
    text += ":";
    const std::vector<StandardLine> standards =
        name == kStandardCombo ? StandardLines(*PickableCombo(inner)) : std::vector<StandardLine>();
    for (std::size_t i = 0; i < lines.size(); ++i) {
      text += "\n  " + std::to_string(i + 1) + "  " + lines[i];
      if (i < standards.size() && !standards[i].key.empty()) text += "  (PLM standard, key " + standards[i].key + ")";
    }
    return text;
  }
  case ZEPAppKind::Editor:
    if (name == kRatioEditor) {
      double low = 0, high = 0;
      return "a scale ratio as 1:50, 1/50 or a number" +
             (RatioBounds(RangeBeside(inner), low, high) ? " from " + Number(low) + " to " + Number(high) + " at this scale range"
                                            : std::string()) +
             " (--range N for another range)";
    }
    return "a text in UTF-8, not empty, without control characters";
  case ZEPAppKind::Push:
    if (name == kAddPLMStandard) {
      std::string text = "the display name or the unique key of a standard of the PLM repository:";
      for (const ZEPPLMSetup::Standard& s : ZEPPLMSetup::Repository())
        text += "\n  " + s.name + "  (key " + s.key + ")";
      if (ZEPPLMSetup::Repository().empty()) text += " it lists none";
      return text;
    }
    if (name == kRemovePLMStandard) return "the display name or the unique key of a listed PLM standard";
    if (opensNewerDialog)
      return "open, accept, cancel or reject: what to do with the dialog it opens";
    return "nothing: it is a button that opens a dialog; set the controls listed under that dialog";
  case ZEPAppKind::Other:
    break;
  }
  return "nothing: it cannot be set from the command line";
}

// ---- a page's controls --------------------------------------------------------------------------
std::vector<ZEPAppControl> PageControls(ZEPDialog* iPage,
                                        const std::vector<std::string>& iDialogButtons) {
  std::vector<ZEPAppControl> controls;
  if (!iPage) return controls;
  std::vector<ZEPDialog*> open;
  for (ZEPDialog* child : iPage->GetChildren())
    if (ZEPSysDynamicCast<ZEPDlgDialog>(child)) open.push_back(child);
  for (ZEPDialog* dialog : open)
    ZEPDlgDriver::CloseDialog(dialog);
  if (!open.empty()) ZEPDlgDriver::Idle();

  for (ZEPDialog* child : iPage->GetChildren())
    Walk(child, "", controls);
  for (ZEPAppControl& c : controls)
    for (const char* name : kNewerDialogButtons)
      c.opensNewerDialog = c.opensNewerDialog || c.name == name;
  for (const std::string& name : iDialogButtons) {
    ZEPDialog* button = ZEPDlgDriver::Find(iPage, name);
    if (!button || !button->IsEffectivelyEnabled()) continue; // its dialog cannot be opened now
    const std::vector<ZEPDialog*> before = iPage->GetChildren();
    if (!ZEPDlgDriver::Click(button)) continue;
    for (ZEPDialog* child : iPage->GetChildren()) {
      if (!ZEPSysDynamicCast<ZEPDlgDialog>(child) ||
          std::find(before.begin(), before.end(), child) != before.end())
        continue;
      const std::size_t first = controls.size();
      for (ZEPDialog* grandChild : child->GetChildren())
        Walk(grandChild, "", controls);
      for (std::size_t i = first; i < controls.size(); ++i) {
        controls[i].section = TitleOf(*child) + " (dialog of \"" + TitleOf(*button) + "\")";
        controls[i].subDialog = child;
        controls[i].opener = button;
      }
    }
  }
  return controls;
}

void CloseSubDialog(const ZEPAppControl& iControl) {
  if (iControl.subDialog) ZEPDlgDriver::CloseDialog(iControl.subDialog);
}

const ZEPAppControl* FindPageControl(const std::vector<ZEPAppControl>& iControls,
                                     const std::string& iName) {
  if (const ZEPAppControl* exact = ByName(iControls, iName)) return exact;
  const ZEPAppControl* found = nullptr;
  for (const ZEPAppControl& c : iControls)
    if (Lower(c.name) == Lower(iName)) {
      if (found) return nullptr; // ambiguous
      found = &c;
    }
  return found;
}

int ShownRange(const std::vector<ZEPAppControl>& iControls) {
  const ZEPAppControl* range = RangeControl(iControls);
  if (!range) return 0;
  const int r = static_cast<ZEP2DBaseRangeCmb*>(range->widget)->GetSelect();
  return r >= 1 && r <= 5 ? r : 0;
}

std::string WhyRefused(const std::vector<ZEPAppControl>& iControls, const ZEPAppControl& iControl) {
  const std::string title = Quoted(iControl.Title());
  if (iControl.Locked()) return title + " is locked: " + iControl.LockText();
  std::string why = ZEPDlgDriver::WhyNotOperable(iControl.inner);
  // A choice is operated through its radios: it is disabled when they all are.
  const std::vector<ZEPDlgRadioButton*> radios = Radios(iControl.inner);
  if (why.empty() && !radios.empty() &&
      std::none_of(radios.begin(), radios.end(),
                   [](ZEPDlgRadioButton* r) { return r->IsEffectivelyEnabled(); }))
    why = ZEPDlgDriver::WhyNotOperable(radios.front());
  if (why.empty()) return "";
  if (why.rfind("locked", 0) == 0) return title + " is " + why; // a lock further up the tree
  if (why == "hidden") return title + " is hidden on this page";
  for (const Dependency& d : kDependencies) {
    const ZEPAppControl* needed = d.control == iControl.name ? ByName(iControls, d.needs) : nullptr;
    const char* blocking = d.whileOn ? "off" : "on";
    if (!needed || needed->Shown() != blocking) continue;
    std::string text = title + " is disabled while " + Quoted(needed->Title()) + " is " + blocking;
    if (int range = d.perRange ? ShownRange(iControls) : 0) {
      ZEPICkeScalesServices_var scales = ZEPGlobalFunctions2::GetScalesServices();
      if (scales)
        text += " for the " + scales->GetScaleName(static_cast<ZEPCkeScale>(range)).str() +
                " scale range";
    }
    return text + "; turn " + Quoted(needed->Title()) + " (" + needed->name + ") " +
           (d.whileOn ? "on" : "off") + " first";
  }
  for (const AnyOf& rule : kAnyOf) {
    if (rule.control != iControl.name) continue;
    std::vector<const ZEPAppControl*> needed;
    for (const char* name : rule.needs)
      if (const ZEPAppControl* c = ByName(iControls, name)) needed.push_back(c);
    if (needed.empty() ||
        std::any_of(needed.begin(), needed.end(),
                    [](const ZEPAppControl* c) { return c->Shown() == "on"; }))
      continue;
    std::string names;
    for (std::size_t i = 0; i < needed.size(); ++i)
      names += (i == 0 ? "" : i + 1 == needed.size() ? " or " : ", ") + Quoted(needed[i]->Title()) +
               " (" + needed[i]->name + ")";
    return title + " is disabled while all of these are off; turn " + names + " on first";
  }
  for (const ChoiceRule& rule : kChoiceRules) {
    const ZEPAppControl* choice =
        rule.control == iControl.name ? ByName(iControls, rule.choice) : nullptr;
    if (!choice) continue;
    const std::vector<std::string> texts = Choices(*choice);
    const std::string shown = choice->Shown();
    const auto at = std::find(texts.begin(), texts.end(), shown);
    const int index = at == texts.end() ? -1 : static_cast<int>(at - texts.begin());
    if (std::find(rule.allowed.begin(), rule.allowed.end(), index) != rule.allowed.end()) continue;
    std::string wanted;
    for (std::size_t i = 0; i < rule.allowed.size(); ++i)
      if (rule.allowed[i] < static_cast<int>(texts.size()))
        wanted += (i == 0 ? "" : " or ") + Quoted(texts[static_cast<std::size_t>(rule.allowed[i])]);
    return title + " is disabled while " + Quoted(choice->Title()) + " is " + Quoted(shown) +
           "; choose " + wanted + " (" + choice->name + ") first";
  }
  if (iControl.name == std::string(kRatioEditor) + "Dec")
    return title + " only shows the scale ratio as a decimal number; set " + kRatioEditor + " instead";
  if (iControl.name == kRemovePLMStandard)
    return title + " is enabled while a PLM standard is current; set it to a listed PLM standard, which it makes "
                   "current first";
  return title + " is disabled on this page";
}

// ---- values -----------------------------------------------------------------------------------
bool ParseSpinnerValue(const ZEPDlgSpinner& iSpinner, const std::string& iText, double& oInternal,
                       std::string& oError) {
  const std::string text = Trim(iText);
  const std::size_t length = NumberLength(text);
  if (length == 0) {
    oError = Quoted(iText) + " is not a number";
    return false;
  }
  const double number = std::strtod(text.substr(0, length).c_str(), nullptr);
  const std::string word = Trim(text.substr(length));
  const Magnitude own = MagnitudeOf(iSpinner.GetUnit());
  if (!std::isfinite(number)) {
    oError = Quoted(iText) + " is too large";
    return false;
  }
  // The unit the control shows ("30 %" as get prints it) is the same as none.
  if (word.empty() || Lower(word) == Lower(iSpinner.UnitSymbol())) {
    oInternal = iSpinner.FromDisplay(number);
  } else {
    const UnitWord* unit = nullptr;
    for (const UnitWord& u : kUnitWords)
      if (Lower(word) == u.word) unit = &u;
    if (own == Magnitude::None) {
      oError = Quoted(word) + ": this control takes a plain number, without a unit";
      return false;
    }
    if (!unit || MagnitudeOf(unit->unit) != own) {
      oError = Quoted(word) + " is not " +
               (own == Magnitude::Length ? "a length unit (" : "an angle unit (") +
               (own == Magnitude::Length ? kLengthWords : kAngleWords) + ")";
      return false;
    }
    ZEPDlgSpinner probe(nullptr, "unitProbe", ZEPDlgSpnDouble);
    probe.SetUnit(unit->unit);
    oInternal = probe.FromDisplay(number);
  }
  if (!std::isfinite(oInternal)) {
    oError = Quoted(iText) + " is too large";
    return false;
  }
  if (TakesWholeNumbers(iSpinner) && !IsWhole(oInternal)) {
    oError = Quoted(iText) + " is not a whole number";
    return false;
  }
  return true;
}

namespace {

ZEPAppOutcome Done(const ZEPAppControl& iControl, bool iChanged) {
  ZEPAppOutcome out;
  out.changed = iChanged;
  out.message = iControl.Title() + ": " + iControl.Shown();
  if (!iChanged) out.message += " (unchanged)";
  return out;
}

ZEPAppOutcome Fail(int iCode, std::string iMessage) {
  ZEPAppOutcome out;
  out.code = iCode;
  out.message = std::move(iMessage);
  return out;
}

ZEPAppOutcome BadValue(const ZEPAppControl& iControl, const std::string& iWhy) {
  return Fail(kExitBadValue, iWhy + "; " + Quoted(iControl.Title()) + " (" + iControl.name +
                                 ") takes " + iControl.Accepts());
}

ZEPAppOutcome Refused(const ZEPAppControl& iControl) {
  return Fail(kExitRefused, Quoted(iControl.Title()) + " did not accept the change");
}

// The line the user means: its number from 1, else its text, its start, or its word in
// parentheses ("mm" for "Millimetre (mm)"), ignoring case. -1 when none or several fit.
int FindLine(const std::vector<std::string>& iLines, const std::string& iText) {
  const std::string wanted = Lower(Trim(iText));
  if (wanted.empty()) return -1;
  if (std::all_of(wanted.begin(), wanted.end(),
                  [](char c) { return std::isdigit(static_cast<unsigned char>(c)); })) {
    if (wanted.size() > 6) return -1;
    const int n = std::atoi(wanted.c_str());
    return n >= 1 && n <= static_cast<int>(iLines.size()) ? n - 1 : -1;
  }
  using Test = bool (*)(const std::string& line, const std::string& wanted);
  const Test tests[] = {
      [](const std::string& l, const std::string& w) { return l == w; },
      [](const std::string& l, const std::string& w) { return l.rfind(w, 0) == 0; },
      [](const std::string& l, const std::string& w) {
        return l.find("(" + w + ")") != std::string::npos;
      },
  };
  for (Test test : tests) {
    int found = -1, count = 0;
    for (std::size_t i = 0; i < iLines.size(); ++i)
      if (test(Lower(iLines[i]), wanted)) {
        found = static_cast<int>(i);
        ++count;
      }
    if (count == 1) return found;
    if (count > 1) return -1;
  }
  return -1;
}

// A colour typed by the user: "R G B" (0 to 255 each, commas allowed) or "#RRGGBB". False when
// the text is neither (it may still be the text of a line).
bool ParseColor(const std::string& iText, unsigned int oRgb[3]) {
  std::string text = Trim(iText);
  if (text.size() == 7 && text[0] == '#') {
    for (std::size_t i = 1; i < 7; ++i)
      if (!std::isxdigit(static_cast<unsigned char>(text[i]))) return false;
    const unsigned long v = std::strtoul(text.c_str() + 1, nullptr, 16);
    oRgb[0] = (v >> 16) & 0xFF;
    oRgb[1] = (v >> 8) & 0xFF;
    oRgb[2] = v & 0xFF;
    return true;
  }
  for (char& c : text)
    if (c == ',') c = ' ';
  int count = 0;
  std::size_t at = 0;
  while (count < 4) {
    at = text.find_first_not_of(' ', at);
    if (at == std::string::npos) break;
    const std::size_t end = std::min(text.find(' ', at), text.size());
    const std::string word = text.substr(at, end - at);
    if (word.size() > 3 || !std::all_of(word.begin(), word.end(), [](char c) {
          return std::isdigit(static_cast<unsigned char>(c));
        }))
      return false;
    if (count < 3) oRgb[count] = static_cast<unsigned int>(std::atoi(word.c_str()));
    ++count;
    at = end;
  }
  return count == 3;
}

// The dialog of the newer framework the page opened last and still shows; null if none.
ZEPVidFraDialog* ShownNewerDialog(const std::vector<ZEPVidFraWindow*>& iBefore) {
  ZEPVidFraDialog* found = nullptr;
  for (ZEPVidFraWindow* w : ZEPVidFraWindow::Windows())
    if (w->IsVisible() && !w->IsDestructionRequested() &&
        std::find(iBefore.begin(), iBefore.end(), w) == iBefore.end())
      found = ZEPSysDynamicCast<ZEPVidFraDialog>(w);
  return found;
}

// A button that opens a dialog of the newer framework: opened through the button, then ended
// as asked, the way a user does it.
ZEPAppOutcome OperateNewerDialog(const ZEPAppControl& iControl, const std::string& iText) {
  const std::string word = Lower(Trim(iText));
  bool (*end)(ZEPVidFraDialog*) = nullptr;
  if (word == "accept" || word == "ok")
    end = &ZEPDlgDriver::Accept;
  else if (word == "cancel")
    end = &ZEPDlgDriver::Cancel;
  else if (word == "reject" || word == "close")
    end = &ZEPDlgDriver::Reject;
  else if (word != "open")
    return BadValue(iControl, Quoted(iText) + " is not something to do with its dialog");
  const std::vector<ZEPVidFraWindow*> before = ZEPVidFraWindow::Windows();
  ZEPCheckLog::Clear();
  if (!ZEPDlgDriver::Click(iControl.inner)) return Refused(iControl);
  ZEPVidFraDialog* dialog = ShownNewerDialog(before);
  if (!dialog) {
    std::string why = "the dialog of " + Quoted(iControl.Title()) + " could not be opened";
    if (ZEPCheckLog::Count()) why += " (" + ZEPCheckLog::Entries().back().expression + ")";
    return Fail(kExitFailure, why);
  }
  ZEPAppOutcome out;
  out.message = iControl.Title() + ": the dialog opened";
  if (auto* panel = ZEPSysDynamicCast<ZEPDbsManageCustomListVID>(dialog->GetApplicativeWidget())) {
    out.message += " with the lists";
    for (const std::string& list : panel->GetLists())
      out.message += " " + Quoted(list);
  }
  if (auto* legend = ZEPSysDynamicCast<ZEPDbsLegendTableLayoutVID>(dialog))
    out.message += " for " + Quoted(legend->GetContext());
  if (!end) return out;
  if (!end(dialog)) return Refused(iControl);
  ZEPDlgDriver::Idle();
  const bool ended = ShownNewerDialog(before) == nullptr;
  out.message += std::string(", was ") +
                 (end == &ZEPDlgDriver::Accept   ? "accepted"
                  : end == &ZEPDlgDriver::Cancel ? "cancelled"
                                                 : "rejected") +
                 (ended ? " and closed" : " but is still open");
  if (!ended) out.code = kExitFailure;
  return out;
}

// The standard combo: a line by its number, its text or, for a PLM standard, its key; picked
// from the open list as the user does (the page rebuilds the lines as it opens and closes).
ZEPAppOutcome ChooseStandard(const ZEPAppControl& iControl, const std::string& iText) {
  const ZEPDlgCombo* combo = PickableCombo(iControl.inner);
  // Numbers and texts are those of the closed combo, as show lists them: a current name that is
  // in neither list is its line 1 then, and is no line of the open list.
  const std::vector<StandardLine> shown = StandardLines(*combo);
  int line = -1;
  std::vector<std::string> texts;
  for (std::size_t i = 0; i < shown.size(); ++i) {
    texts.push_back(shown[i].text);
    if (!shown[i].key.empty() && shown[i].key == Trim(iText)) line = static_cast<int>(i);
  }
  if (line < 0) line = FindLine(texts, iText);
  if (!ZEPDlgDriver::DropDown(iControl.inner)) return Refused(iControl);
  const int extra = static_cast<int>(shown.size()) - combo->GetLineCount(); // 1 with that line
  if (line >= 0 && line < extra) {
    ZEPDlgDriver::CloseUp(iControl.inner);
    return Done(iControl, false); // the current name itself
  }
  line -= line >= 0 ? extra : 0;
  const int selected = combo->GetSelect();
  const bool picked = line >= 0 && line != selected && ZEPDlgDriver::Select(iControl.inner, line);
  ZEPDlgDriver::CloseUp(iControl.inner);
  if (line < 0) {
    const auto same = std::count(texts.begin(), texts.end(), Trim(iText));
    return BadValue(iControl, Quoted(iText) + (same > 1 ? " is the name of " + std::to_string(same) +
                                                              " PLM standards: give the key of the one meant"
                                                        : " is not one of its lines"));
  }
  if (line == selected) return Done(iControl, false);
  if (!picked) return Refused(iControl);
  return Done(iControl, true);
}

// The add button: the standard of the PLM repository named by its key or display name is
// chosen in the PLM object chooser that the button opens, and the chooser validated.
ZEPAppOutcome AddPLMStandard(const ZEPAppControl& iControl, const std::string& iText) {
  const std::string wanted = Trim(iText);
  const std::vector<ZEPPLMSetup::Standard>& repository = ZEPPLMSetup::Repository();
  std::vector<const ZEPPLMSetup::Standard*> found;
  for (const ZEPPLMSetup::Standard& s : repository)
    if (s.key == wanted) found = {&s};
  for (int pass = 0; pass < 2 && found.empty(); ++pass) // the name as typed, then ignoring case
    for (const ZEPPLMSetup::Standard& s : repository)
      if (pass == 0 ? s.name == wanted : Lower(s.name) == Lower(wanted)) found.push_back(&s);
  if (found.empty()) return BadValue(iControl, Quoted(iText) + " is not in the PLM repository");
  if (found.size() > 1) {
    std::string keys;
    for (const ZEPPLMSetup::Standard* s : found) keys += (keys.empty() ? "" : ", ") + s->key;
    return BadValue(iControl, Quoted(iText) + " is the name of " + std::to_string(found.size()) +
                                  " standards of the PLM repository (keys " + keys + "): give the key of the one meant");
  }
  const ZEPPLMSetup::Standard chosen = *found.front();
  if (chosen.unicity < 0)
    return BadValue(iControl, "the PLM repository does not guarantee the key " + chosen.key + " of " +
                                  Quoted(chosen.name) + " to be unique, so the page does not take it");
  const std::vector<std::string> keys = StoredTexts("StandardPLMIDList");
  if (std::find(keys.begin(), keys.end(), chosen.key) != keys.end()) {
    ZEPAppOutcome out;
    out.message = Quoted(chosen.name) + " (key " + chosen.key + ") is listed already (unchanged)";
    return out;
  }
  ZEPCheckLog::Clear();
  if (!ZEPDlgDriver::Click(iControl.inner)) return Refused(iControl);
  ZEPIPLMChooser* chooser = ZEPPLMSetup::LiveChooser();
  if (!chooser || chooser->GetVisibility() != ZEPDlgShow) {
    std::string why = "the PLM object chooser could not be opened";
    if (ZEPCheckLog::Count()) why += " (" + ZEPCheckLog::Entries().back().expression + ")";
    return Fail(kExitFailure, why);
  }
  // The user picks the object the chooser lists, as the repository gives it.
  const std::vector<ZEPPLMSetup::Standard> listed = ZEPPLMSetup::Listed(chooser);
  const auto it = std::find_if(listed.begin(), listed.end(),
                               [&](const ZEPPLMSetup::Standard& s) { return s.key == chosen.key; });
  if (it == listed.end()) {
    ZEPPLMSetup::Cancel();
    return Fail(kExitFailure, "the PLM object chooser does not offer " + Quoted(chosen.name));
  }
  if (!ZEPPLMSetup::Validate({*it})) return Fail(kExitFailure, "the PLM object chooser could not be validated");
  if (ZEPCheckLog::Count())
    return Fail(kExitFailure, "the page did not take " + Quoted(chosen.name) + " (" +
                                  ZEPCheckLog::Entries().back().expression + ")");
  ZEPAppOutcome out;
  out.changed = true;
  out.message = "Added " + Quoted(chosen.name) + " (key " + chosen.key + ") from the PLM repository; it is the "
                "current standard";
  return out;
}

// The remove button removes the current PLM standard: the one named is made current first,
// and the standard that was current before is chosen again when it is still listed.
ZEPAppOutcome RemovePLMStandard(const std::vector<ZEPAppControl>& iControls, const ZEPAppControl& iControl,
                                const std::string& iText) {
  const ZEPAppControl* combo = ByName(iControls, kStandardCombo);
  if (!combo) return Fail(kExitFailure, "the page has no standard combo");
  const std::string why = WhyRefused(iControls, *combo);
  if (!why.empty()) return Fail(kExitRefused, why);
  const std::vector<StandardLine> lines = StandardLines(*PickableCombo(combo->inner));
  std::vector<std::string> names, keys;
  for (const StandardLine& l : lines)
    if (!l.key.empty()) {
      names.push_back(l.text);
      keys.push_back(l.key);
    }
  auto at = std::find(keys.begin(), keys.end(), Trim(iText));
  if (at == keys.end()) {
    const int line = FindLine(names, iText);
    at = line < 0 ? keys.end() : keys.begin() + line;
  }
  if (at == keys.end()) {
    std::string listed;
    for (std::size_t i = 0; i < names.size(); ++i) listed += "\n  " + names[i] + "  (key " + keys[i] + ")";
    return Fail(kExitBadValue, Quoted(iText) + " is not a listed PLM standard (give its name or its key); " +
                                   Quoted(iControl.Title()) + " (" + iControl.name + ") takes " +
                                   (names.empty() ? std::string("nothing now: no PLM standard is listed") :
                                                    "one of:" + listed));
  }
  const std::string key = *at, name = names[static_cast<std::size_t>(at - keys.begin())];
  // What was current, to choose it again: a PLM standard by its key, a folder one by its text.
  const int before = PickableCombo(combo->inner)->GetSelect();
  const std::string previous = before >= 0 && static_cast<std::size_t>(before) < lines.size()
                                   ? (lines[static_cast<std::size_t>(before)].key.empty()
                                          ? lines[static_cast<std::size_t>(before)].text
                                          : lines[static_cast<std::size_t>(before)].key)
                                   : "";
  const ZEPAppOutcome current = ChooseStandard(*combo, key);
  if (current.code != kExitOk) return current;
  const std::string notNow = WhyRefused(iControls, iControl);
  if (!notNow.empty()) return Fail(kExitRefused, notNow);
  if (!ZEPDlgDriver::Click(iControl.inner)) return Refused(iControl);
  if (!previous.empty() && previous != key) ChooseStandard(*combo, previous);
  ZEPAppOutcome out;
  out.changed = true;
  out.message = "Removed " + Quoted(name) + " (key " + key + "); " + combo->Title() + ": " + combo->Shown();
  return out;
}

// The scale ratio of the range shown: parsed and bounded as the page does it, so that a
// refusal says why; then typed in.
ZEPAppOutcome EnterRatio(const ZEPAppControl& iControl, const std::string& iText) {
  ZEPUnicodeString normal, shownNormal;
  double value = 1.0, shown = 1.0;
  int form = 0;
  if (FAILED(ZEPDfuScaleAndUnitsToolbox::ConvertScaleFromStringToDouble(iText, normal, value, form)))
    return BadValue(iControl, Quoted(iText) + " is not a scale ratio");
  const int range = RangeBeside(iControl.inner);
  double low = 0, high = 0;
  if (!RatioBounds(range, low, high))
    return Fail(kExitBadValue, "no scale ratio is accepted at this scale range: the host gives it no tolerances");
  if (value < low || value > high)
    return BadValue(iControl, Quoted(iText) + " (" + Number(value) + ") is outside the limits");
  auto* editor = ZEPSysDynamicCast<ZEPDlgEditor>(iControl.inner);
  const bool same = SUCCEEDED(ZEPDfuScaleAndUnitsToolbox::ConvertScaleFromStringToDouble(
                        editor->GetText(), shownNormal, shown, form)) &&
                    std::fabs(shown - value) <= 1e-9 * value;
  if (same) return Done(iControl, false);
  if (!ZEPDlgDriver::EnterText(iControl.inner, iText)) return Refused(iControl);
  // The page shows the stored ratio again: what it shows now is what it took.
  if (FAILED(ZEPDfuScaleAndUnitsToolbox::ConvertScaleFromStringToDouble(editor->GetText(), shownNormal, shown,
                                                                         form)) ||
      std::fabs(shown - value) > 1e-6 * value)
    return Fail(kExitBadValue, Quoted(iControl.Title()) + " did not take " + Quoted(iText));
  return Done(iControl, true);
}

// A text editor: UTF-8 text, not empty, without control characters. A folder that this
// computer does not have is taken with a warning: it may exist where drawings are made.
ZEPAppOutcome EnterText(const ZEPAppControl& iControl, const std::string& iText) {
  if (iControl.name == kRatioEditor) return EnterRatio(iControl, iText);
  if (ZEPFirstBadUtf8(iText) != std::string::npos) return BadValue(iControl, "the text is not valid UTF-8");
  if (Trim(iText).empty()) return BadValue(iControl, "an empty text");
  if (std::any_of(iText.begin(), iText.end(), [](char c) {
        return static_cast<unsigned char>(c) < 0x20 || c == 0x7F;
      }))
    return BadValue(iControl, "the text holds a control character (a line break, a tab)");
  const auto* editor = ZEPSysDynamicCast<ZEPDlgEditor>(iControl.inner);
  if (editor->GetText().str() == iText) return Done(iControl, false);
  if (!ZEPDlgDriver::EnterText(iControl.inner, iText)) return Refused(iControl);
  ZEPAppOutcome out = Done(iControl, true);
  std::error_code ec;
  for (const char* name : kFolderEditors)
    if (iControl.name == name && !std::filesystem::is_directory(iText, ec))
      out.warning = "there is no folder " + Quoted(iText) + " on this computer; it is kept as typed";
  return out;
}

} // namespace

ZEPAppOutcome OperateControl(const std::vector<ZEPAppControl>& iControls,
                             const ZEPAppControl& iControl, const std::string& iText) {
  // The remove button waits for a PLM standard to be current: choosing it is part of removing.
  if (iControl.name == kRemovePLMStandard && !iControl.Locked())
    return RemovePLMStandard(iControls, iControl, iText);
  const std::string why = WhyRefused(iControls, iControl);
  if (!why.empty()) return Fail(kExitRefused, why);
  switch (iControl.Kind()) {
  case ZEPAppKind::Check: {
    const std::string word = Lower(Trim(iText));
    bool on = false;
    if (word == "on" || word == "yes" || word == "true" || word == "1")
      on = true;
    else if (word == "off" || word == "no" || word == "false" || word == "0")
      on = false;
    else
      return BadValue(iControl, Quoted(iText) + " is neither on nor off");
    const bool isOn =
        ZEPSysDynamicCast<ZEPDlgCheckButton>(iControl.inner)->GetState() == ZEPDlgChecked;
    if (isOn == on) return Done(iControl, false);
    if (!ZEPDlgDriver::Click(iControl.inner)) return Refused(iControl);
    return Done(iControl, true);
  }
  case ZEPAppKind::Spinner: {
    const auto* spinner = ZEPSysDynamicCast<ZEPDlgSpinner>(iControl.inner);
    double value = 0;
    std::string error;
    if (!ParseSpinnerValue(*spinner, iText, value, error)) return BadValue(iControl, error);
    if (spinner->HasLimits()) {
      double lo = 0, hi = 0, step = 0;
      spinner->GetMinMaxStep(lo, hi, step);
      // Typed values come through a unit conversion: allow its rounding, the driver clamps it.
      const double slack = 1e-9 * std::max({1.0, std::fabs(lo), std::fabs(hi)});
      if (value < lo - slack || value > hi + slack)
        return BadValue(iControl, spinner->FormatValue(value) + " is outside the limits");
    }
    if (value == spinner->GetValue()) return Done(iControl, false); // what it shows already
    if (!ZEPDlgDriver::Enter(iControl.inner, value)) return Refused(iControl);
    return Done(iControl, true);
  }
  case ZEPAppKind::Combo: {
    const ZEPDlgCombo* combo = PickableCombo(iControl.inner);
    unsigned int rgb[3] = {0, 0, 0};
    if (ZEPSysDynamicCast<ZEPComboColor>(iControl.inner) && ParseColor(iText, rgb)) {
      if (rgb[0] > 255 || rgb[1] > 255 || rgb[2] > 255)
        return BadValue(iControl, Quoted(iText) + " has a component above 255");
      unsigned int shown[3] = {0, 0, 0};
      if (ZEPSysDynamicCast<ZEPComboColor>(iControl.inner)
                  ->GetSelectedColor(&shown[0], &shown[1], &shown[2]) &&
          std::equal(rgb, rgb + 3, shown))
        return Done(iControl, false);
      if (!ZEPDlgDriver::SelectColor(iControl.inner, rgb[0], rgb[1], rgb[2]))
        return Refused(iControl);
      return Done(iControl, true);
    }
    if (iControl.name == kStandardCombo) return ChooseStandard(iControl, iText);
    const int line = FindLine(Lines(*combo), iText);
    if (line < 0) return BadValue(iControl, Quoted(iText) + " is not one of its lines");
    if (line == combo->GetSelect()) return Done(iControl, false);
    if (!ZEPDlgDriver::Select(iControl.inner, line)) return Refused(iControl);
    return Done(iControl, true);
  }
  case ZEPAppKind::Choice: {
    const std::vector<ZEPDlgRadioButton*> radios = Radios(iControl.inner);
    int choice = FindLine(Choices(iControl), iText);
    for (std::size_t i = 0; i < radios.size() && choice < 0; ++i)
      if (Lower(radios[i]->GetOwnName()) == Lower(Trim(iText))) choice = static_cast<int>(i);
    if (choice < 0) return BadValue(iControl, Quoted(iText) + " is not one of its choices");
    ZEPDlgRadioButton* radio = radios[static_cast<std::size_t>(choice)];
    if (radio->GetState() == ZEPDlgChecked) return Done(iControl, false);
    if (!ZEPDlgDriver::Click(radio)) return Refused(iControl);
    return Done(iControl, true);
  }
  case ZEPAppKind::Push:
    if (iControl.opensNewerDialog) return OperateNewerDialog(iControl, iText);
    if (iControl.name == kAddPLMStandard) return AddPLMStandard(iControl, iText);
    if (iControl.name == kRemovePLMStandard) return RemovePLMStandard(iControls, iControl, iText);
    break;
  case ZEPAppKind::Editor:
    return EnterText(iControl, iText);
  case ZEPAppKind::Other:
    break;
  }
  return Fail(kExitUsage,
              Quoted(iControl.Title()) + " (" + iControl.name + ") takes " + iControl.Accepts());
}

ZEPAppOutcome SelectRange(const std::vector<ZEPAppControl>& iControls, int iRange) {
  const ZEPAppControl* range = RangeControl(iControls);
  if (!range) return Fail(kExitUsage, "this page has no scale range");
  if (ShownRange(iControls) == iRange) return Done(*range, false);
  ZEPICkeScalesServices_var scales = ZEPGlobalFunctions2::GetScalesServices();
  const std::string name = scales && iRange >= 1 && iRange <= 5
                               ? scales->GetScaleName(static_cast<ZEPCkeScale>(iRange)).str()
                               : "";
  const std::vector<std::string> lines = Lines(*static_cast<ZEPDlgCombo*>(range->widget));
  const auto it = name.empty() ? lines.end() : std::find(lines.begin(), lines.end(), name);
  if (it == lines.end())
    return BadValue(*range, "scale range " + std::to_string(iRange) + " is not activated");
  const std::string why = WhyRefused(iControls, *range);
  if (!why.empty()) return Fail(kExitRefused, why);
  if (!ZEPDlgDriver::Select(range->inner, static_cast<int>(it - lines.begin())))
    return Refused(*range);
  return Done(*range, true);
}

std::vector<ZEPAppOffer> OfferedValues(const std::vector<ZEPAppControl>& iControls, const ZEPAppControl& iControl) {
  std::vector<ZEPAppOffer> offers;
  if (iControl.name == kAddPLMStandard) {
    for (const ZEPPLMSetup::Standard& s : ZEPPLMSetup::Repository())
      offers.push_back({s.name + "  (key " + s.key + ")", s.key});
  } else if (iControl.name == kRemovePLMStandard) {
    if (const ZEPAppControl* combo = ByName(iControls, kStandardCombo))
      if (const ZEPDlgCombo* lines = PickableCombo(combo->inner))
        for (const StandardLine& l : StandardLines(*lines))
          if (!l.key.empty()) offers.push_back({l.text + "  (key " + l.key + ")", l.key});
  }
  return offers;
}

std::vector<std::string> ZEPAppControl::ChoiceTexts() const {
  const ZEPAppKind kind = Kind();
  if (kind != ZEPAppKind::Combo && kind != ZEPAppKind::Choice) return {};
  return Choices(*this);
}

std::size_t TextWidth(const std::string& iText) {
  std::size_t n = 0;
  for (unsigned char c : iText)
    if ((c & 0xC0) != 0x80) ++n;
  return n;
}

} // namespace zepapp
