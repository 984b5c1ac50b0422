#include "ZEPVidDialogs.h"

#include "ZEPDialog.h"
#include "ZEPDlgDriver.h"

#include <algorithm>
#include <memory>
#include <unordered_map>

ZEP_IMPLEMENT_CLASS(ZEPSYPEventArgs, ZEPBaseUnknown)
ZEP_IMPLEMENT_CLASS(ZEPSYPEventHandler, ZEPBaseUnknown)
ZEP_IMPLEMENT_CLASS(ZEPVidWidget, ZEPBaseUnknown)
ZEP_IMPLEMENT_CLASS(ZEPVidFraWindow, ZEPVidWidget)
ZEP_IMPLEMENT_CLASS(ZEPVidFraDialog, ZEPVidFraWindow)
ZEP_IMPLEMENT_CLASS(ZEPDbsManageCustomListVID, ZEPVidWidget)
ZEP_IMPLEMENT_CLASS(ZEPDbsLegendTableLayoutVID, ZEPVidFraDialog)

namespace {
struct Settings {
  bool customListFails = false;
  bool legendFails = false;
  bool contentNotPanel = false;
  bool withoutArgs = false;
  std::vector<std::string> lists = {"Months", "Days of the week", "Sheet sizes"};
};
Settings& Config() {
  static Settings settings;
  return settings;
}

std::unordered_map<const ZEPVidWidget*, std::uint64_t>& LiveWidgets() {
  static std::unordered_map<const ZEPVidWidget*, std::uint64_t> live;
  return live;
}

// The windows, owned by the registry until their delayed destruction.
std::vector<std::unique_ptr<ZEPVidFraWindow>>& Registry() {
  static std::vector<std::unique_ptr<ZEPVidFraWindow>> windows;
  return windows;
}

template <class W> W* Register(W* iWindow) {
  Registry().emplace_back(iWindow);
  return iWindow;
}

// A custom list dialog: the panel as its applicative widget.
class CustomListDialog : public ZEPVidFraDialog {
public:
  explicit CustomListDialog(ZEPCommand* iParent) : ZEPVidFraDialog(iParent, "CustomListDialog") {
    if (Config().contentNotPanel)
      SetApplicativeWidget(new ZEPVidWidget());
    else
      SetApplicativeWidget(new ZEPDbsManageCustomListVID());
  }
};
} // namespace

// ---- weak references ------------------------------------------------------------------------
ZEPBaseUnknown_WR::ZEPBaseUnknown_WR(ZEPBaseUnknown* iObject) {
  if (auto* command = dynamic_cast<ZEPCommand*>(iObject)) {
    _pObject = iObject;
    _pCommand = command;
    _serial = command->GetSerial();
  } else if (auto* widget = dynamic_cast<ZEPVidWidget*>(iObject)) {
    _pObject = iObject;
    _pWidget = widget;
    _serial = widget->GetSerial();
  }
}

ZEPBaseUnknown* ZEPBaseUnknown_WR::Resolve() const {
  // The registries compare addresses only, so asking about a gone object is safe.
  if (_pCommand) return ZEPCommand::IsLive(_pCommand, _serial) ? _pObject : nullptr;
  if (_pWidget) return ZEPVidWidget::IsAlive(_pWidget, _serial) ? _pObject : nullptr;
  return nullptr;
}

// ---- events -------------------------------------------------------------------------------------
void ZEPSYPEventHandler::Release() {
  if (--_refs == 0) delete this;
}

ZEPVidWidget::ZEPVidWidget() {
  static std::uint64_t next = 0;
  _serial = ++next;
  LiveWidgets()[this] = _serial;
}

ZEPVidWidget::~ZEPVidWidget() {
  LiveWidgets().erase(this);
  for (Subscription& s : _handlers)
    s.handler->Release();
}

bool ZEPVidWidget::IsAlive(const ZEPVidWidget* iWidget, std::uint64_t iSerial) {
  auto it = LiveWidgets().find(iWidget);
  return it != LiveWidgets().end() && it->second == iSerial;
}

void ZEPVidWidget::AddHandler(const ZEPSYPEvent& iEvent, ZEPSYPEventHandler* iHandler, int) {
  if (!iHandler) return;
  iHandler->AddRef();
  _handlers.push_back({iEvent, iHandler});
}

void ZEPVidWidget::Raise(const ZEPSYPEvent& iEvent, ZEPSYPEventArgs* iArgs) {
  // A handler may add handlers: run those present now, each held for the time of its call.
  std::vector<ZEPSYPEventHandler*> called;
  for (const Subscription& s : _handlers)
    if (s.event == iEvent) called.push_back(s.handler);
  for (ZEPSYPEventHandler* h : called)
    h->AddRef();
  for (ZEPSYPEventHandler* h : called) {
    h->Handle(this, iArgs);
    h->Release();
  }
}

int ZEPVidWidget::HandlerCount(const ZEPSYPEvent& iEvent) const {
  return static_cast<int>(std::count_if(_handlers.begin(), _handlers.end(),
                                        [&](const Subscription& s) { return s.event == iEvent; }));
}

// ---- windows ------------------------------------------------------------------------------------
ZEPVidFraWindow::ZEPVidFraWindow(ZEPCommand* iParent, const std::string& iName)
    : _parent(iParent), _name(iName) {}

ZEPVidFraWindow::~ZEPVidFraWindow() { delete _pContent; }

ZEPCommand* ZEPVidFraWindow::GetParentCommand() const {
  return static_cast<ZEPCommand*>(_parent.Resolve());
}

const ZEPSYPEvent& ZEPVidFraWindow::Closed() {
  static const ZEPSYPEvent event("ZEPVidFraWindow.Closed");
  return event;
}

void ZEPVidFraWindow::CloseItself() {
  _visible = false;
  _destructionRequested = true;
  ZEPSYPEventArgs args;
  Raise(Closed(), Config().withoutArgs ? nullptr : &args);
}

std::vector<ZEPVidFraWindow*> ZEPVidFraWindow::Windows() {
  std::vector<ZEPVidFraWindow*> out;
  for (const auto& w : Registry())
    out.push_back(w.get());
  return out;
}

void ZEPVidFraWindow::RunDelayedDestructions() {
  // Move the ending windows out first: a destructor may not reach the registry.
  std::vector<std::unique_ptr<ZEPVidFraWindow>> ending;
  auto& windows = Registry();
  for (auto& w : windows)
    if (w->_destructionRequested) ending.push_back(std::move(w));
  windows.erase(std::remove(windows.begin(), windows.end(), nullptr), windows.end());
}

const ZEPSYPEvent& ZEPVidFraDialog::RejectButtonClicked() {
  static const ZEPSYPEvent event("ZEPVidFraDialog.RejectButtonClicked");
  return event;
}

// ---- the drafting dialogs -----------------------------------------------------------------------
ZEPVidFraDialog* ZEPDbsManageCustomListVID::CreateCustomListDialog(ZEPCommand* iParent) {
  if (Config().customListFails) return nullptr;
  return Register(new CustomListDialog(iParent));
}

const ZEPSYPEvent& ZEPDbsManageCustomListVID::AcceptBtnPressed() {
  static const ZEPSYPEvent event("ZEPDbsManageCustomListVID.AcceptBtnPressed");
  return event;
}

const ZEPSYPEvent& ZEPDbsManageCustomListVID::CancelBtnPressed() {
  static const ZEPSYPEvent event("ZEPDbsManageCustomListVID.CancelBtnPressed");
  return event;
}

void ZEPDbsManageCustomListVID::BuildFromPreferencesAndSettings() {
  _lists = Config().lists;
  _built = true;
}

ZEPDbsLegendTableLayoutVID::ZEPDbsLegendTableLayoutVID(ZEPCommand* iParent,
                                                       const ZEPString& iContext)
    : ZEPVidFraDialog(iParent, "LegendTableLayoutDialog"), _context(iContext) {}

ZEPVidFraDialog*
ZEPDbsLegendTableLayoutVID::CreateLegendTableLayoutDialog(ZEPCommand* iParent,
                                                          const ZEPString& iContext) {
  if (Config().legendFails) return nullptr;
  return Register(new ZEPDbsLegendTableLayoutVID(iParent, iContext));
}

// ---- setup --------------------------------------------------------------------------------------
void ZEPVidSetup::SetCustomListFactoryFails(bool iFails) { Config().customListFails = iFails; }
void ZEPVidSetup::SetLegendFactoryFails(bool iFails) { Config().legendFails = iFails; }
void ZEPVidSetup::SetCustomListContentIsNotPanel(bool iNotPanel) {
  Config().contentNotPanel = iNotPanel;
}
void ZEPVidSetup::SetEventsWithoutArgs(bool iWithout) { Config().withoutArgs = iWithout; }
bool ZEPVidSetup::EventsWithoutArgs() { return Config().withoutArgs; }
void ZEPVidSetup::SetCustomLists(const std::vector<std::string>& iLists) {
  Config().lists = iLists;
}
std::vector<std::string> ZEPVidSetup::GetCustomLists() { return Config().lists; }

void ZEPVidSetup::Reset() {
  std::vector<std::unique_ptr<ZEPVidFraWindow>> all;
  all.swap(Registry());
  all.clear();
  Config() = Settings();
}

// ---- the user at these dialogs ------------------------------------------------------------------
namespace {
bool Operable(ZEPVidFraDialog* iDialog) {
  if (!iDialog) return false;
  const auto& windows = Registry();
  const bool registered = std::any_of(windows.begin(), windows.end(),
                                      [&](const auto& w) { return w.get() == iDialog; });
  return registered && iDialog->IsVisible() && !iDialog->IsDestructionRequested();
}
} // namespace

bool ZEPDlgDriver::Accept(ZEPVidFraDialog* iDialog) {
  if (!Operable(iDialog)) return false;
  if (auto* panel = ZEPSysDynamicCast<ZEPDbsManageCustomListVID>(iDialog->GetApplicativeWidget())) {
    ZEPSYPEventArgs args;
    panel->Raise(ZEPDbsManageCustomListVID::AcceptBtnPressed(),
                 Config().withoutArgs ? nullptr : &args);
    return true;
  }
  iDialog->OnAccept();
  return true;
}

bool ZEPDlgDriver::Cancel(ZEPVidFraDialog* iDialog) {
  if (!Operable(iDialog)) return false;
  if (auto* panel = ZEPSysDynamicCast<ZEPDbsManageCustomListVID>(iDialog->GetApplicativeWidget())) {
    ZEPSYPEventArgs args;
    panel->Raise(ZEPDbsManageCustomListVID::CancelBtnPressed(),
                 Config().withoutArgs ? nullptr : &args);
    return true;
  }
  return Reject(iDialog);
}

bool ZEPDlgDriver::Reject(ZEPVidFraDialog* iDialog) {
  if (!Operable(iDialog)) return false;
  ZEPSYPEventArgs args;
  iDialog->Raise(ZEPVidFraDialog::RejectButtonClicked(), Config().withoutArgs ? nullptr : &args);
  // Nobody handled it: the window ends on its own.
  if (!args.IsConsumed() && iDialog->IsVisible() && !iDialog->IsDestructionRequested())
    iDialog->CloseItself();
  return true;
}
