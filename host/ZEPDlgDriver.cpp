#include "ZEPDlgDriver.h"
#include "ZEPSettings.h"
#include "ZEPVidDialogs.h"

#include <cmath>

ZEPDialog* ZEPDlgDriver::Find(ZEPDialog* iRoot, const ZEPString& iName) {
  if (!iRoot) return nullptr;
  if (iRoot->GetOwnName() == iName) return iRoot;
  for (ZEPDialog* child : iRoot->GetChildren())
    if (ZEPDialog* found = Find(child, iName)) return found;
  return nullptr;
}

ZEPDialog* ZEPDlgDriver::FindControl(ZEPDialog* iRoot, const ZEPString& iName) {
  if (ZEPDialog* inner = Find(iRoot, iName + "_dialog")) return inner;
  return Find(iRoot, iName);
}

std::string ZEPDlgDriver::WhyNotOperable(const ZEPDialog* iWidget) {
  if (!iWidget) return "no such widget";
  for (const ZEPDialog* w = iWidget; w; w = w->GetParentDialog()) {
    const ZEPDlgLock* lock = w->GetGoverningLock();
    if (lock && lock->IsLocked())
      return lock->GetLockText().empty() ? std::string("locked") : "locked by " + lock->GetLockText();
  }
  for (const ZEPDialog* w = iWidget; w; w = w->GetParentDialog())
    if (w->GetVisibility() == ZEPDlgHide) return "hidden";
  for (const ZEPDialog* w = iWidget; w; w = w->GetParentDialog())
    if (w->GetSensitivity() == ZEPDlgDisable) return "disabled";
  return "";
}

bool ZEPDlgDriver::Click(ZEPDialog* iWidget) {
  if (!iWidget || !iWidget->IsEffectivelyEnabled()) return false;
  if (auto* check = ZEPSysDynamicCast<ZEPDlgCheckButton>(iWidget)) {
    check->SetState(check->GetState() == ZEPDlgChecked ? ZEPDlgUnchecked : ZEPDlgChecked, 0);
    check->SendNotification(check->GetChkBModifyNotification());
    return true;
  }
  if (auto* radio = ZEPSysDynamicCast<ZEPDlgRadioButton>(iWidget)) {
    if (radio->GetState() == ZEPDlgChecked) return true; // already selected: nothing to tell
    ZEPDlgRadioButton* previous = radio->GetOtherOn();
    radio->SetState(ZEPDlgChecked, 0);
    if (previous) previous->SendNotification(previous->GetRadBModifyNotification());
    radio->SendNotification(radio->GetRadBModifyNotification());
    return true;
  }
  if (auto* push = ZEPSysDynamicCast<ZEPDlgPushButton>(iWidget)) {
    push->SendNotification(push->GetPushBActivateNotification());
    return true;
  }
  return false;
}

bool ZEPDlgDriver::Enter(ZEPDialog* iWidget, double iValue) {
  if (!iWidget || !iWidget->IsEffectivelyEnabled() || !std::isfinite(iValue)) return false;
  if (auto* spinner = ZEPSysDynamicCast<ZEPDlgSpinner>(iWidget)) {
    spinner->SetValue(spinner->Clamp(iValue), 0);
    spinner->SendNotification(spinner->GetSpinnerModifyNotification());
    return true;
  }
  if (auto* slider = ZEPSysDynamicCast<ZEPDlgSlider>(iWidget)) {
    float v = static_cast<float>(iValue);
    v = v < slider->GetMin() ? slider->GetMin() : (v > slider->GetMax() ? slider->GetMax() : v);
    slider->SetCurrentValue(v, 0);
    slider->SendNotification(slider->GetSliderDragNotification());
    return true;
  }
  if (auto* editor = ZEPSysDynamicCast<ZEPDlgEditor>(iWidget)) {
    editor->SetValue(iValue, 0);
    editor->SendNotification(editor->GetEditModifyNotification());
    return true;
  }
  return false;
}

bool ZEPDlgDriver::EnterText(ZEPDialog* iWidget, const ZEPUnicodeString& iText) {
  if (!iWidget || !iWidget->IsEffectivelyEnabled()) return false;
  auto* editor = ZEPSysDynamicCast<ZEPDlgEditor>(iWidget);
  if (!editor) return false;
  editor->SetText(iText, 0);
  editor->SendNotification(editor->GetEditModifyNotification());
  return true;
}

namespace {
// The combo the user picks lines in: the widget itself or an application combo's own.
ZEPDlgCombo* PickableCombo(ZEPDialog* iWidget) {
  if (auto* combo = ZEPSysDynamicCast<ZEPDlgCombo>(iWidget)) return combo;
  if (auto* numbered = ZEPSysDynamicCast<ZEPNumberedCombo>(iWidget)) return numbered->GetCombo();
  if (auto* colour = ZEPSysDynamicCast<ZEPComboColor>(iWidget)) return colour->GetCombo();
  return nullptr;
}
} // namespace

bool ZEPDlgDriver::Select(ZEPDialog* iWidget, int iIndex) {
  if (!iWidget || !iWidget->IsEffectivelyEnabled()) return false;
  if (auto* box = ZEPSysDynamicCast<ZEPDlgIconBox>(iWidget)) {
    if (box->SetSelect(iIndex, 0) < 0) return false;
    box->SendNotification(box->GetIBoxSelectNotification());
    return true;
  }
  ZEPDlgCombo* combo = PickableCombo(iWidget);
  if (!combo || !combo->IsEffectivelyEnabled()) return false;
  if (iIndex < 0 || iIndex >= combo->GetLineCount()) return false;
  if (auto* colour = ZEPSysDynamicCast<ZEPComboColor>(combo->GetParentDialog())) {
    // Picking a named colour line selects that colour.
    static const unsigned int rgb[][3] = {{0, 0, 0},     {255, 255, 255}, {255, 0, 0},   {0, 255, 0},
                                          {0, 0, 255},   {255, 255, 0},   {255, 0, 255}, {0, 255, 255},
                                          {128, 0, 0},   {140, 140, 140}};
    if (iIndex < static_cast<int>(sizeof rgb / sizeof rgb[0]))
      colour->SetSelectedColor(rgb[iIndex][0], rgb[iIndex][1], rgb[iIndex][2]);
    else combo->SetSelect(iIndex, 0);
  } else {
    combo->SetSelect(iIndex, 0);
  }
  combo->SendNotification(combo->GetComboSelectNotification());
  return true;
}

namespace {
// The user opens (iDrop) or closes the list of an operable combo.
bool OpenOrCloseList(ZEPDialog* iWidget, bool iDrop) {
  ZEPDlgCombo* combo =
      iWidget && iWidget->IsEffectivelyEnabled() ? PickableCombo(iWidget) : nullptr;
  if (!combo || !combo->IsEffectivelyEnabled()) return false;
  combo->SendNotification(iDrop ? combo->GetComboDropNotification()
                                : combo->GetComboCloseUpNotification());
  return true;
}
} // namespace

bool ZEPDlgDriver::DropDown(ZEPDialog* iWidget) { return OpenOrCloseList(iWidget, true); }
bool ZEPDlgDriver::CloseUp(ZEPDialog* iWidget) { return OpenOrCloseList(iWidget, false); }

bool ZEPDlgDriver::SelectColor(ZEPDialog* iWidget, unsigned int iRed, unsigned int iGreen, unsigned int iBlue) {
  if (!iWidget || !iWidget->IsEffectivelyEnabled()) return false;
  auto* colour = ZEPSysDynamicCast<ZEPComboColor>(iWidget);
  if (!colour) colour = ZEPSysDynamicCast<ZEPComboColor>(iWidget->GetParentDialog());
  if (!colour || !colour->IsEffectivelyEnabled() || iRed > 255 || iGreen > 255 || iBlue > 255) return false;
  colour->SetSelectedColor(iRed, iGreen, iBlue);
  colour->GetCombo()->SendNotification(colour->GetCombo()->GetComboSelectNotification());
  return true;
}

bool ZEPDlgDriver::Close(ZEPDialog* iDialog) {
  auto* window = ZEPSysDynamicCast<ZEPDlgWindow>(iDialog);
  if (!window || !window->IsEffectivelyEnabled()) return false;
  window->SendNotification(window->GetWindCloseNotification());
  return true;
}

bool ZEPDlgDriver::CloseDialog(ZEPDialog* iDialog) {
  auto* dialog = ZEPSysDynamicCast<ZEPDlgDialog>(iDialog);
  if (!dialog || !dialog->IsEffectivelyEnabled()) return false;
  dialog->SendNotification(dialog->GetDiaCLOSENotification());
  return true;
}

void ZEPDlgDriver::Idle() {
  ZEPDialog::RunDelayedDestructions();
  ZEPVidFraWindow::RunDelayedDestructions();
}

namespace {
std::string QuoteText(const std::string& s) {
  std::string out = "\"";
  for (char c : s) {
    if (c == '\n') out += "\\n";
    else if (c == '"' || c == '\\') out += std::string("\\") + c;
    else out += c;
  }
  return out + "\"";
}

bool DisabledBySensitivity(const ZEPDialog* w) {
  for (; w; w = w->GetParentDialog())
    if (w->GetSensitivity() == ZEPDlgDisable) return true;
  return false;
}

// A frame around a control shows its title through that control: print it once.
bool TitleShownByChild(const ZEPDialog* w) {
  if (std::string(w->KindName()) != "frame") return false;
  for (const ZEPDialog* child : w->GetChildren())
    if (child->GetTitle() == w->GetTitle()) return true;
  return false;
}

void DumpWidget(const ZEPDialog* w, int depth, std::string& out) {
  out.append(static_cast<size_t>(depth) * 2, ' ');
  out += w->KindName();
  out += " " + QuoteText(w->GetOwnName());
  const ZEPDialog::Cell& c = w->GetGridConstraints();
  if (c.set) {
    out += " @" + std::to_string(c.row) + "," + std::to_string(c.column);
    if (c.width != 1 || c.height != 1) out += " span " + std::to_string(c.width) + "x" + std::to_string(c.height);
  }
  if (!w->GetTitle().IsEmpty() && !TitleShownByChild(w)) out += " title=" + QuoteText(w->GetTitle().str());
  if (!w->GetIconName().empty() && !ZEPSysDynamicCast<ZEPDlgLock>(const_cast<ZEPDialog*>(w)))
    out += " icon=" + w->GetIconName();
  w->DumpState(out);
  if (w->GetVisibility() == ZEPDlgHide) out += " hidden";
  else if (DisabledBySensitivity(w)) out += " disabled";
  out += "\n";
  for (const ZEPDialog* child : w->GetChildren()) DumpWidget(child, depth + 1, out);
}
} // namespace

std::string ZEPDlgDriver::Dump(const ZEPDialog* iRoot) {
  std::string out;
  if (iRoot) DumpWidget(iRoot, 0, out);
  return out;
}
