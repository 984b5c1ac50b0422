#include "ZEPDialog.h"
#include "ZEPSettings.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstdio>
#include <typeindex>
#include <typeinfo>
#include <unordered_map>

ZEP_IMPLEMENT_CLASS(ZEPNotification, ZEPBaseUnknown)
ZEP_IMPLEMENT_CLASS(ZEPDlgComboDropNotification, ZEPNotification)
ZEP_IMPLEMENT_CLASS(ZEPDlgComboCloseUpNotification, ZEPNotification)
ZEP_IMPLEMENT_CLASS(ZEPCommand, ZEPBaseUnknown)
ZEP_IMPLEMENT_CLASS(ZEPDialog, ZEPCommand)
ZEP_IMPLEMENT_CLASS(ZEPDlgFrame, ZEPDialog)
ZEP_IMPLEMENT_CLASS(ZEPDlgToolsOptionsFrame, ZEPDlgFrame)
ZEP_IMPLEMENT_CLASS(ZEPDlgContainer, ZEPDlgFrame)
ZEP_IMPLEMENT_CLASS(ZEPDlgWindow, ZEPDialog)
ZEP_IMPLEMENT_CLASS(ZEPDlgDialog, ZEPDlgWindow)
ZEP_IMPLEMENT_CLASS(ZEPDlgCheckButton, ZEPDialog)
ZEP_IMPLEMENT_CLASS(ZEPDlgRadioButton, ZEPDialog)
ZEP_IMPLEMENT_CLASS(ZEPDlgPushButton, ZEPDialog)
ZEP_IMPLEMENT_CLASS(ZEPDlgLabel, ZEPDialog)
ZEP_IMPLEMENT_CLASS(ZEPDlgCombo, ZEPDialog)
ZEP_IMPLEMENT_CLASS(ZEPNumberedCombo, ZEPDlgFrame)
ZEP_IMPLEMENT_CLASS(ZEPComboDashed, ZEPNumberedCombo)
ZEP_IMPLEMENT_CLASS(ZEPComboWeight, ZEPNumberedCombo)
ZEP_IMPLEMENT_CLASS(ZEPComboSymbol, ZEPNumberedCombo)
ZEP_IMPLEMENT_CLASS(ZEPComboColor, ZEPDlgFrame)
ZEP_IMPLEMENT_CLASS(ZEPDlgControl, ZEPDialog)
ZEP_IMPLEMENT_CLASS(ZEPDlgSpinner, ZEPDlgControl)
ZEP_IMPLEMENT_CLASS(ZEPDlgEditor, ZEPDlgControl)
ZEP_IMPLEMENT_CLASS(ZEPDlgSlider, ZEPDialog)
ZEP_IMPLEMENT_CLASS(ZEPDlgIconBox, ZEPDialog)

// ---- commands -------------------------------------------------------------------------------
namespace {
// Live commands and their serial numbers: a callback never reaches a destroyed command,
// even when a new one has taken its address.
std::unordered_map<const ZEPCommand*, std::uint64_t>& Live() {
  static std::unordered_map<const ZEPCommand*, std::uint64_t> live;
  return live;
}
std::uint64_t NextSerial() {
  static std::uint64_t serial = 0;
  return ++serial;
}
bool IsAlive(const ZEPCommand* iCommand, std::uint64_t iSerial) {
  auto it = Live().find(iCommand);
  return it != Live().end() && it->second == iSerial;
}
} // namespace

ZEPCommand::ZEPCommand() : _serial(NextSerial()) { Live()[this] = _serial; }

bool ZEPCommand::IsLive(const ZEPCommand* iCommand, std::uint64_t iSerial) {
  return IsAlive(iCommand, iSerial);
}

ZEPCommand::~ZEPCommand() {
  Live().erase(this);
  for (const Sender& s : _senders) {
    if (!IsAlive(s.sender, s.serial)) continue;
    auto& subs = s.sender->_subscriptions;
    subs.erase(std::remove_if(subs.begin(), subs.end(),
                              [this](const Subscription& x) { return x.subscriber == this; }),
               subs.end());
  }
}

ZEPCommand* ZEPCommand::GetFather() const {
  return _pFather && IsAlive(_pFather, _fatherSerial) ? _pFather : nullptr;
}

void ZEPCommand::SetFather(ZEPCommand* iFather) {
  // A father chain that comes back here would send notifications round for ever.
  for (ZEPCommand* c = iFather; c; c = c->GetFather())
    if (c == this) return;
  _pFather = iFather;
  _fatherSerial = iFather ? iFather->_serial : 0;
}

void ZEPCommand::AddCallback(ZEPCommand* iSender, ZEPNotification* iNotif, Callback iCallback, void* iData) {
  if (!iSender || !iNotif || !iCallback) return;
  iSender->_subscriptions.push_back({iNotif, this, _serial, std::move(iCallback), iData});
  _senders.push_back({iSender, iSender->_serial});
}

ZEPNotification* ZEPCommand::OwnNotification(const char* iKind) {
  for (auto& n : _notifications)
    if (n->GetKind() == iKind) return n.get();
  _notifications.push_back(std::make_unique<ZEPNotification>(this, iKind));
  return _notifications.back().get();
}

std::vector<ZEPNotification*> ZEPCommand::GetNotifications() const {
  std::vector<ZEPNotification*> out;
  for (const auto& n : _notifications) out.push_back(n.get());
  return out;
}

void ZEPCommand::RunCallbacks(ZEPNotification* iNotif, ZEPCommand* iSender) {
  // A callback may register or remove callbacks: run on a copy, and skip the
  // subscribers that have gone in between.
  std::uint64_t serial = _serial;
  std::vector<Subscription> subs = _subscriptions;
  for (const Subscription& s : subs) {
    if (s.notif != iNotif) continue;
    if (!IsAlive(this, serial) || !IsAlive(s.subscriber, s.subscriberSerial)) continue;
    s.callback(iSender, iNotif, s.data);
  }
}

void ZEPCommand::SendNotification(ZEPNotification* iNotif) {
  if (!iNotif) return;
  // Collect the chain first: a callback may destroy part of it.
  std::vector<std::pair<ZEPCommand*, std::uint64_t>> chain;
  for (ZEPCommand* c = this; c; c = c->GetFather()) chain.push_back({c, c->_serial});
  for (auto& link : chain)
    if (IsAlive(link.first, link.second)) link.first->RunCallbacks(iNotif, link.first);
}

void ZEPCommand::DeliverAs(ZEPNotification* iNotif, ZEPCommand* iApparentSender) {
  if (iNotif) RunCallbacks(iNotif, iApparentSender);
}

// ---- widgets --------------------------------------------------------------------------------
namespace {
std::vector<ZEPDialog*>& DelayedQueue() {
  static std::vector<ZEPDialog*> queue;
  return queue;
}
} // namespace

ZEPDialog::ZEPDialog(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle)
    : _pParent(iParent), _name(iName), _style(iStyle) {
  if (_pParent) _pParent->_children.push_back(this);
  LoadCatalogTexts();
}

ZEPDialog::~ZEPDialog() {
  auto& q = DelayedQueue();
  q.erase(std::remove(q.begin(), q.end(), this), q.end());
  // Children first, last created first; each detaches itself from this list.
  while (!_children.empty()) delete _children.back();
  if (_pGoverningLock) _pGoverningLock->RemoveAssociatedDialog(this);
  if (_pParent) {
    auto& siblings = _pParent->_children;
    siblings.erase(std::remove(siblings.begin(), siblings.end(), this), siblings.end());
  }
}

ZEPString ZEPDialog::GetResourceFilename(int) const { return ZEPString(); }

namespace {
// The catalogs of a widget's GetResourceFilename chain, looked up once per class: the chain
// belongs to the class (during construction, to the part constructed so far, which typeid
// tells apart).
const std::vector<const ZEPMsgCatalog::Loaded*>& CatalogChain(const ZEPDialog& iWidget) {
  static std::unordered_map<std::type_index, std::vector<const ZEPMsgCatalog::Loaded*>> chains;
  static unsigned generation = ZEPMsgCatalog::Generation();
  if (generation != ZEPMsgCatalog::Generation()) {
    chains.clear(); // the catalogs were forgotten
    generation = ZEPMsgCatalog::Generation();
  }
  auto [it, added] = chains.try_emplace(std::type_index(typeid(iWidget)));
  if (added)
    for (int i = 0; i < 16; ++i) {
      const ZEPString name = iWidget.GetResourceFilename(i);
      if (name.empty()) break;
      it->second.push_back(&ZEPMsgCatalog::Get(name));
    }
  return it->second;
}
} // namespace

// A new widget takes the title and help texts of its name from the catalogs of its
// ancestors, nearest ancestor and most derived catalog first: one look-up of its name in each.
void ZEPDialog::LoadCatalogTexts() {
  static ZEPUnicodeString ZEPDialog::*const kTexts[ZEPMsgCatalog::WidgetTextCount] = {
      &ZEPDialog::_title, &ZEPDialog::_help, &ZEPDialog::_shortHelp, &ZEPDialog::_longHelp};
  int missing = ZEPMsgCatalog::WidgetTextCount;
  bool found[ZEPMsgCatalog::WidgetTextCount] = {};
  for (const ZEPDialog* a = _pParent; a && missing > 0; a = a->_pParent)
    for (const ZEPMsgCatalog::Loaded* catalog : CatalogChain(*a)) {
      const std::string* const* texts = ZEPMsgCatalog::FindWidget(*catalog, _name);
      for (int k = 0; texts && k < ZEPMsgCatalog::WidgetTextCount; ++k)
        if (!found[k] && texts[k]) {
          this->*kTexts[k] = ZEPUnicodeString(*texts[k]);
          found[k] = true;
          --missing;
        }
    }
}

void ZEPDialog::SetGridConstraints(short iRow, short iColumn, short iWidth, short iHeight,
                                   unsigned int iJustification) {
  _cell.set = true;
  _cell.row = iRow;
  _cell.column = iColumn;
  _cell.width = iWidth;
  _cell.height = iHeight;
  _cell.justification = iJustification;
}

void ZEPDialog::SetGridColumnResizable(int, int) {}
void ZEPDialog::SetGridRowResizable(int, int) {}

void ZEPDialog::SetSensitivity(unsigned long iSensitivity) {
  // A widget governed by a closed padlock stays disabled, whoever asks.
  if (_pGoverningLock && _pGoverningLock->IsLocked()) iSensitivity = ZEPDlgDisable;
  _sensitivity = iSensitivity;
}

bool ZEPDialog::IsEffectivelyEnabled() const {
  for (const ZEPDialog* w = this; w; w = w->_pParent)
    if (w->_sensitivity == ZEPDlgDisable || w->_visibility == ZEPDlgHide) return false;
  return true;
}

void ZEPDialog::SetIconName(const ZEPString& iNormal, const ZEPString&, const ZEPString&, const ZEPString&, short) {
  _icon = iNormal;
}

void ZEPDialog::RequestDelayedDestruction() {
  auto& q = DelayedQueue();
  if (std::find(q.begin(), q.end(), this) == q.end()) q.push_back(this);
}

void ZEPDialog::RunDelayedDestructions() {
  auto& q = DelayedQueue();
  while (!q.empty()) {
    ZEPDialog* w = q.front();
    q.erase(q.begin());
    delete w; // also drops any queued descendants from the queue
  }
}

ZEPDlgFrame::ZEPDlgFrame(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle)
    : ZEPDialog(iParent, iName, iStyle) {}

ZEPDlgToolsOptionsFrame::ZEPDlgToolsOptionsFrame(ZEPDialog* iParent, const ZEPString& iName,
                                                 const ZEPString& iIconName, unsigned long iStyle)
    : ZEPDlgFrame(iParent, iName, iStyle) {
  SetIconName(iIconName);
  _pOptions = new ZEPDlgFrame(this, "OptionsFrame", 0x80001);
  _pOptions->SetGridConstraints(0, 0, 1, 1, 0x1E);
}

ZEPDlgContainer::ZEPDlgContainer(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle)
    : ZEPDlgFrame(iParent, iName, iStyle) {}

ZEPDlgWindow::ZEPDlgWindow(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle)
    : ZEPDialog(iParent, iName, iStyle) {}

void ZEPDlgWindow::GetRectDimensions(ZEPRect* oRect) const {
  if (oRect) *oRect = _rect;
}
void ZEPDlgWindow::SetRectDimensions(const ZEPRect& iRect, int) { _rect = iRect; }

ZEPDlgDialog::ZEPDlgDialog(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle)
    : ZEPDlgWindow(iParent, iName, iStyle) {
  SetVisibility(ZEPDlgHide); // a dialog box shows when asked to
}

// ---- buttons ------------------------------------------------------------------------------------
ZEPDlgCheckButton::ZEPDlgCheckButton(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle)
    : ZEPDialog(iParent, iName, iStyle) {}

void ZEPDlgCheckButton::SetState(unsigned long iState, int) {
  _state = iState == ZEPDlgChecked ? ZEPDlgChecked : ZEPDlgUnchecked;
}

void ZEPDlgCheckButton::DumpState(std::string& ioOut) const { ioOut += _state == ZEPDlgChecked ? " [x]" : " [ ]"; }

ZEPDlgRadioButton::ZEPDlgRadioButton(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle)
    : ZEPDialog(iParent, iName, iStyle) {}

void ZEPDlgRadioButton::SetState(unsigned long iState, int) {
  if (iState != ZEPDlgChecked) {
    _state = ZEPDlgUnchecked;
    return;
  }
  while (ZEPDlgRadioButton* other = GetOtherOn()) other->_state = ZEPDlgUnchecked;
  _state = ZEPDlgChecked;
}

ZEPDlgRadioButton* ZEPDlgRadioButton::GetOtherOn() const {
  if (!GetParentDialog()) return nullptr;
  for (ZEPDialog* sibling : GetParentDialog()->GetChildren()) {
    if (sibling == this) continue;
    auto* radio = ZEPSysDynamicCast<ZEPDlgRadioButton>(sibling);
    if (radio && radio->_state == ZEPDlgChecked) return radio;
  }
  return nullptr;
}

void ZEPDlgRadioButton::DumpState(std::string& ioOut) const { ioOut += _state == ZEPDlgChecked ? " (o)" : " ( )"; }

ZEPDlgPushButton::ZEPDlgPushButton(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle)
    : ZEPDialog(iParent, iName, iStyle) {}

ZEPDlgLabel::ZEPDlgLabel(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle)
    : ZEPDialog(iParent, iName, iStyle) {}

// ---- combos -------------------------------------------------------------------------------------
namespace {
std::string Quote(const std::string& s) {
  std::string out = "\"";
  for (char c : s) {
    if (c == '"' || c == '\\') out += '\\';
    if (c == '\n') {
      out += "\\n";
      continue;
    }
    out += c;
  }
  return out + "\"";
}
} // namespace

ZEPDlgCombo::ZEPDlgCombo(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle)
    : ZEPDialog(iParent, iName, iStyle) {}

int ZEPDlgCombo::SetLine(const ZEPUnicodeString& iText, int iIndex, unsigned int iFlags) {
  return SetLine(iText, ZEPString(), iIndex, iFlags);
}

int ZEPDlgCombo::SetLine(const ZEPUnicodeString& iText, const ZEPString& iIconName, int iIndex, unsigned int) {
  if (iIndex < 0 || iIndex >= GetLineCount()) {
    _lines.push_back({iText, iIconName});
    return GetLineCount() - 1;
  }
  _lines.insert(_lines.begin() + iIndex, Line{iText, iIconName});
  if (_selected >= iIndex) ++_selected;
  return iIndex;
}

void ZEPDlgCombo::ClearLine() {
  _lines.clear();
  _selected = -1;
}

int ZEPDlgCombo::SetSelect(int iIndex, int) {
  if (iIndex < 0 || iIndex >= GetLineCount()) return -1;
  _selected = iIndex;
  return iIndex;
}

int ZEPDlgCombo::SetSelect(const ZEPUnicodeString& iText, int iNotify) {
  for (int i = 0; i < GetLineCount(); ++i)
    if (_lines[static_cast<size_t>(i)].text == iText) return SetSelect(i, iNotify);
  return -1;
}

int ZEPDlgCombo::GetLine(ZEPUnicodeString& oText, int iIndex) const {
  if (iIndex < 0 || iIndex >= GetLineCount()) {
    oText = ZEPUnicodeString();
    return -1;
  }
  oText = _lines[static_cast<size_t>(iIndex)].text;
  return iIndex;
}

int ZEPDlgCombo::GetLineIconName(ZEPString& oIconName, int iIndex) const {
  if (iIndex < 0 || iIndex >= GetLineCount()) {
    oIconName.clear();
    return -1;
  }
  oIconName = _lines[static_cast<size_t>(iIndex)].icon;
  return iIndex;
}

void ZEPDlgCombo::DumpState(std::string& ioOut) const {
  ioOut += " lines=[";
  for (int i = 0; i < GetLineCount(); ++i) ioOut += (i ? "|" : "") + _lines[static_cast<size_t>(i)].text.str();
  ioOut += "]";
  if (_selected >= 0) ioOut += " selected=" + Quote(_lines[static_cast<size_t>(_selected)].text.str());
  else ioOut += " selected=none";
}

ZEPNumberedCombo::ZEPNumberedCombo(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle,
                                   const char* iEntryWord, int iEntries, unsigned int iInitial)
    : ZEPDlgFrame(iParent, iName, 0x80001) {
  _pCombo = new ZEPDlgCombo(this, iName + "_combo", iStyle);
  _pCombo->SetGridConstraints(0, 0, 1, 1, 0x1E);
  for (int i = 1; i <= iEntries; ++i) _pCombo->SetLine(std::string(iEntryWord) + " " + std::to_string(i));
  SetSelect(iInitial);
}

unsigned int ZEPNumberedCombo::GetSelect() const {
  int sel = _pCombo->GetSelect();
  return sel < 0 ? 0u : static_cast<unsigned int>(sel + 1);
}

void ZEPNumberedCombo::SetSelect(unsigned int iNumber) {
  if (iNumber >= 1 && iNumber <= static_cast<unsigned int>(_pCombo->GetLineCount()))
    _pCombo->SetSelect(static_cast<int>(iNumber) - 1, 0);
}

void ZEPNumberedCombo::AddOtherType(const ZEPString& iIconName, int) { _pCombo->SetLine(iIconName, iIconName); }

void ZEPNumberedCombo::DumpState(std::string& ioOut) const {
  unsigned int sel = GetSelect();
  ioOut += " entries=" + std::to_string(_pCombo->GetLineCount());
  ioOut += " selected=" + (sel ? std::to_string(sel) : std::string("none"));
}

ZEPComboDashed::ZEPComboDashed(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle,
                               unsigned int iValue, int)
    : ZEPNumberedCombo(iParent, iName, iStyle, "Line type", 7, iValue) {}

ZEPComboWeight::ZEPComboWeight(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle,
                               unsigned int iValue, int)
    : ZEPNumberedCombo(iParent, iName, iStyle, "Weight", 8, iValue) {}

ZEPComboSymbol::ZEPComboSymbol(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle,
                               unsigned int iValue, int)
    : ZEPNumberedCombo(iParent, iName, iStyle, "Symbol", 12, iValue) {}

unsigned int ZEPComboSymbol::GetSelectedSymbol(unsigned int& oSymbol) const {
  oSymbol = GetSelect();
  return oSymbol;
}

namespace {
const struct {
  const char* name;
  unsigned int r, g, b;
} kPalette[] = {{"Black", 0, 0, 0},     {"White", 255, 255, 255}, {"Red", 255, 0, 0},   {"Green", 0, 255, 0},
                {"Blue", 0, 0, 255},    {"Yellow", 255, 255, 0},  {"Magenta", 255, 0, 255},
                {"Cyan", 0, 255, 255},  {"Dark red", 128, 0, 0},  {"Grey", 140, 140, 140}};

std::string ColorName(unsigned int r, unsigned int g, unsigned int b) {
  for (const auto& p : kPalette)
    if (p.r == r && p.g == g && p.b == b) return p.name;
  return "RGB " + std::to_string(r) + "," + std::to_string(g) + "," + std::to_string(b);
}
} // namespace

ZEPComboColor::ZEPComboColor(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle, unsigned int iRed,
                             unsigned int iGreen, unsigned int iBlue, int, int, int)
    : ZEPDlgFrame(iParent, iName, 0x80001) {
  _pCombo = new ZEPDlgCombo(this, iName + "_combo", iStyle);
  _pCombo->SetGridConstraints(0, 0, 1, 1, 0x1E);
  for (const auto& p : kPalette) _pCombo->SetLine(p.name);
  SetSelectedColor(iRed, iGreen, iBlue);
}

int ZEPComboColor::GetSelectedColor(unsigned int* oRed, unsigned int* oGreen, unsigned int* oBlue) const {
  if (!_hasColor) return 0;
  if (oRed) *oRed = _rgb[0];
  if (oGreen) *oGreen = _rgb[1];
  if (oBlue) *oBlue = _rgb[2];
  return 1;
}

int ZEPComboColor::GetSelectedColor(unsigned int* oRed, unsigned int* oGreen, unsigned int* oBlue,
                                    ZEPUnicodeString* oName) const {
  int rc = GetSelectedColor(oRed, oGreen, oBlue);
  if (rc && oName) *oName = ColorName(_rgb[0], _rgb[1], _rgb[2]);
  return rc;
}

// A colour outside the named ones gets a line of its own.
void ZEPComboColor::SetSelectedColor(unsigned int iRed, unsigned int iGreen, unsigned int iBlue) {
  _rgb[0] = iRed > 255 ? 255 : iRed;
  _rgb[1] = iGreen > 255 ? 255 : iGreen;
  _rgb[2] = iBlue > 255 ? 255 : iBlue;
  _hasColor = true;
  std::string name = ColorName(_rgb[0], _rgb[1], _rgb[2]);
  if (_pCombo->SetSelect(ZEPUnicodeString(name), 0) < 0) _pCombo->SetSelect(_pCombo->SetLine(name), 0);
}

void ZEPComboColor::DumpState(std::string& ioOut) const {
  if (_hasColor) ioOut += " colour=" + Quote(ColorName(_rgb[0], _rgb[1], _rgb[2]));
  else ioOut += " colour=none";
}

// ---- value controls ----------------------------------------------------------------------------
ZEPDlgControl::ZEPDlgControl(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle)
    : ZEPDialog(iParent, iName, iStyle) {}

namespace {
struct UnitInfo {
  ZEPDlgUnit unit;
  const char* symbol;
  double perInternal; // displayed = internal * perInternal
};
const UnitInfo kUnits[] = {
    {43, "m", 1.0},          {44, "um", 1.0e6},        {45, "mm", 1000.0},
    {46, "cm", 100.0},       {47, "km", 0.001},        {48, "in", 1.0 / 0.0254},
    {49, "ft", 1.0 / 0.3048}, {50, "in", 1.0 / 0.0254}, {51, "in", 1.0 / 0.0254},
    {52, "in", 1.0 / 0.0254}, {11, "rad", 1.0},         {12, "deg", 57.29577951308232},
    {15, "gr", 63.66197723675813}, {25, "%", 100.0}};
const UnitInfo* FindUnit(ZEPDlgUnit iUnit) {
  for (const UnitInfo& u : kUnits)
    if (u.unit == iUnit) return &u;
  return nullptr;
}
} // namespace

double ZEPDlgControl::ToDisplay(double iValue) const {
  const UnitInfo* u = FindUnit(_unit);
  return u ? iValue * u->perInternal : iValue;
}

double ZEPDlgControl::FromDisplay(double iDisplayed) const {
  const UnitInfo* u = FindUnit(_unit);
  return u ? iDisplayed / u->perInternal : iDisplayed;
}

std::string ZEPDlgControl::UnitSymbol() const {
  const UnitInfo* u = FindUnit(_unit);
  return u ? u->symbol : "";
}

namespace {
// printf into a string of the size the text needs.
template <class... A> std::string Printed(const char* iFormat, A... iArgs) {
  const int size = std::snprintf(nullptr, 0, iFormat, iArgs...);
  if (size <= 0) return std::string();
  std::string text(static_cast<size_t>(size) + 1, '\0');
  std::snprintf(text.data(), text.size(), iFormat, iArgs...);
  text.resize(static_cast<size_t>(size));
  return text;
}
} // namespace

std::string ZEPDlgControl::FormatValue(double iValue) const {
  const double shown = ToDisplay(iValue);
  std::string text;
  if (_precision > 0 && std::fabs(shown) < 1e15) {
    text = Printed("%.*f", _precision > 12 ? 12 : _precision, shown);
    if (text.find('.') != std::string::npos) {
      while (text.back() == '0') text.pop_back();
      if (text.back() == '.') text.pop_back();
    }
    if (text == "-0") text = "0";
  } else if (_precision > 0) {
    // Beyond the digits a double holds: its shortest exact form rather than made-up zeros.
    char digits[32];
    const auto result = std::to_chars(digits, digits + sizeof digits, shown);
    text.assign(digits, result.ptr);
  } else {
    text = Printed("%g", shown);
  }
  const std::string sym = UnitSymbol();
  return sym.empty() ? text : text + " " + sym;
}

ZEPDlgSpinner::ZEPDlgSpinner(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle)
    : ZEPDlgControl(iParent, iName, iStyle) {}

void ZEPDlgSpinner::SetRange(float iMin, float iMax, int iSteps, int iFlag) {
  _rangeFlag = iFlag;
  _min = iMin;
  _max = iMax;
  _step = iSteps > 0 ? (static_cast<double>(iMax) - iMin) / iSteps : 1.0;
  _hasLimits = true;
}

void ZEPDlgSpinner::SetRange(float iMin, float iMax, float iStep, int iFlag) {
  _rangeFlag = iFlag;
  _min = iMin;
  _max = iMax;
  _step = iStep;
  _hasLimits = true;
}

void ZEPDlgSpinner::GetRange(float& oMin, float& oMax, int& oSteps) const {
  oMin = static_cast<float>(_min);
  oMax = static_cast<float>(_max);
  oSteps = _step > 0 ? static_cast<int>(std::lround((_max - _min) / _step)) : 0;
}

void ZEPDlgSpinner::GetRange(float& oMin, float& oMax, float& oStep) const {
  oMin = static_cast<float>(_min);
  oMax = static_cast<float>(_max);
  oStep = static_cast<float>(_step);
}

void ZEPDlgSpinner::SetMinMaxStep(double iMin, double iMax, double iStep, int iFlag) {
  _rangeFlag = iFlag;
  _min = iMin;
  _max = iMax;
  _step = iStep;
  _hasLimits = true;
}

void ZEPDlgSpinner::GetMinMaxStep(double& oMin, double& oMax, double& oStep) const {
  oMin = _min;
  oMax = _max;
  oStep = _step;
}

double ZEPDlgSpinner::Clamp(double iValue) const {
  if (!_hasLimits) return iValue;
  return std::max(_min, std::min(_max, iValue));
}

void ZEPDlgSpinner::DumpState(std::string& ioOut) const {
  ioOut += " value=" + FormatValue(_value);
  if (_hasLimits) ioOut += " range=" + FormatValue(_min) + ".." + FormatValue(_max) + " step=" + FormatValue(_step);
}

ZEPDlgEditor::ZEPDlgEditor(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle)
    : ZEPDlgControl(iParent, iName, iStyle) {}

void ZEPDlgEditor::SetValue(double iValue, int) { _text = ZEPUnicodeString(FormatValue(iValue)); }

void ZEPDlgEditor::DumpState(std::string& ioOut) const { ioOut += " text=" + Quote(_text.str()); }

ZEPDlgSlider::ZEPDlgSlider(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle)
    : ZEPDialog(iParent, iName, iStyle) {}

void ZEPDlgSlider::SetRange(float iMin, float iMax, int iSteps) {
  _min = iMin;
  _max = iMax;
  _steps = iSteps;
}

float ZEPDlgSlider::SetCurrentValue(float iValue, int) {
  _value = iValue;
  return _value;
}

void ZEPDlgSlider::DumpState(std::string& ioOut) const {
  char buf[96];
  std::snprintf(buf, sizeof buf, " value=%g range=%g..%g", _value, _min, _max);
  ioOut += buf;
}

ZEPDlgIconBox::ZEPDlgIconBox(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle)
    : ZEPDialog(iParent, iName, iStyle) {}

int ZEPDlgIconBox::SetSelect(int iIndex, int) {
  if (iIndex < 0 || iIndex >= GetIconCount()) return -1;
  _selected = iIndex;
  return iIndex;
}

int ZEPDlgIconBox::SetSelect(const ZEPString& iIconName, int iNotify) {
  for (int i = 0; i < GetIconCount(); ++i)
    if (_icons[static_cast<size_t>(i)] == iIconName) return SetSelect(i, iNotify);
  return -1;
}

void ZEPDlgIconBox::DumpState(std::string& ioOut) const {
  ioOut += " icons=" + std::to_string(GetIconCount());
  ioOut += " selected=" + (_selected >= 0 ? _icons[static_cast<size_t>(_selected)] : std::string("none"));
}
