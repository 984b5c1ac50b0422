#include "ZEPMessageBox.h"

#include <algorithm>

ZEP_IMPLEMENT_CLASS(ZEPVidFraMessageBox, ZEPDlgWindow)

namespace {
struct Screen {
  int shown = 0;
  std::vector<ZEPVidFraMessageBox*> boxes;
};
Screen& TheScreen() {
  static Screen screen;
  return screen;
}
void Leave(ZEPVidFraMessageBox* iBox) {
  auto& boxes = TheScreen().boxes;
  boxes.erase(std::remove(boxes.begin(), boxes.end(), iBox), boxes.end());
}
} // namespace

ZEPVidFraMessageBox::ZEPVidFraMessageBox(ZEPDialog* iParent, const ZEPString& iName)
    : ZEPDlgWindow(iParent, iName, 0) {
  SetVisibility(ZEPDlgHide);
}

ZEPVidFraMessageBox::~ZEPVidFraMessageBox() { Leave(this); }

void ZEPVidFraMessageBox::SetVisibleFlag(bool iFlag) {
  if (!iFlag) {
    SetVisibility(ZEPDlgHide);
    _onScreen = false;
    Leave(this);
    return;
  }
  if (_onScreen || _answer) return;
  SetVisibility(ZEPDlgShow);
  _onScreen = true;
  ++TheScreen().shown;
  TheScreen().boxes.push_back(this);
}

bool ZEPVidFraMessageBox::Answer(int iButton) {
  if (!_onScreen || iButton <= 0 || (iButton & _buttons) != iButton) return false;
  _answer = iButton;
  _onScreen = false;
  Leave(this);
  SetVisibility(ZEPDlgHide);
  SendNotification(GetAnswerNotification());
  if (_autoClose) RequestDelayedDestruction();
  return true;
}

void ZEPVidFraMessageBox::DumpState(std::string& ioOut) const {
  ioOut += " buttons=" + std::to_string(_buttons) + " icon=" + std::to_string(_icon);
  if (!_text.IsEmpty()) ioOut += " text=\"" + _text.str() + "\"";
  if (_answer) ioOut += " answer=" + std::to_string(_answer);
}

int ZEPMessageBoxSetup::ShownCount() { return TheScreen().shown; }
std::vector<ZEPVidFraMessageBox*> ZEPMessageBoxSetup::OnScreen() { return TheScreen().boxes; }
void ZEPMessageBoxSetup::Reset() { TheScreen().shown = 0; }
