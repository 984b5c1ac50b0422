// The newer dialog framework: windows and widgets that raise events to reference-counted
// handlers, weak references, and the two drafting dialogs built on it (custom sort lists and
// legend table layout).
//
// Newer dialogs are not part of the toolkit's widget tree: they live in a host registry until
// their delayed destruction runs at the next idle time (ZEPDlgDriver::Idle), so an event may
// reach a handler after the object that subscribed is gone. Handlers therefore hold their
// subscriber by a weak reference.
#pragma once

#include "ZEPSystem.h"

#include <cstdint>
#include <string>
#include <vector>

class ZEPCommand;
class ZEPVidWidget;

// A weak reference: resolves to the object while it lives, to null once it is gone. Tracks
// toolkit commands (pages, widgets) and newer dialog widgets; any other object resolves null.
class ZEPBaseUnknown_WR {
public:
  ZEPBaseUnknown_WR() = default;
  explicit ZEPBaseUnknown_WR(ZEPBaseUnknown* iObject);
  ZEPBaseUnknown* Resolve() const;
  void Clear() { *this = ZEPBaseUnknown_WR(); }

private:
  // Kept as taken while the object lived: a gone object is never cast or read.
  ZEPBaseUnknown* _pObject = nullptr;
  const ZEPCommand* _pCommand = nullptr;
  const ZEPVidWidget* _pWidget = nullptr;
  std::uint64_t _serial = 0;
};

// An event: identified by its name.
class ZEPSYPEvent {
public:
  explicit ZEPSYPEvent(const char* iName) : _name(iName) {}
  const std::string& GetName() const { return _name; }
  bool operator==(const ZEPSYPEvent& iOther) const { return _name == iOther._name; }

private:
  std::string _name;
};

class ZEPSYPEventArgs : public ZEPBaseUnknown {
  ZEP_DECLARE_CLASS
public:
  // The event was handled: the window that raised it does nothing more with it.
  void Consume() { _consumed = true; }
  bool IsConsumed() const { return _consumed; }

private:
  bool _consumed = false;
};

// Receives events. Counted references: the creator holds one; AddHandler takes another, which
// the widget gives back when it is destroyed; the handler is deleted at the last Release.
class ZEPSYPEventHandler : public ZEPBaseUnknown {
  ZEP_DECLARE_CLASS
public:
  ZEPSYPEventHandler() = default;
  ZEPSYPEventHandler(const ZEPSYPEventHandler&) = delete;
  ZEPSYPEventHandler& operator=(const ZEPSYPEventHandler&) = delete;
  void AddRef() { ++_refs; }
  void Release();
  int GetRefCount() const { return _refs; }
  // iSender: the widget that raised the event; iArgs: its arguments, possibly null.
  virtual void Handle(ZEPBaseUnknown* iSender, ZEPBaseUnknown* iArgs) = 0;

protected:
  ~ZEPSYPEventHandler() override = default;

private:
  int _refs = 1;
};

class ZEPVidWidget : public ZEPBaseUnknown {
  ZEP_DECLARE_CLASS
public:
  ZEPVidWidget();
  ~ZEPVidWidget() override;
  ZEPVidWidget(const ZEPVidWidget&) = delete;
  ZEPVidWidget& operator=(const ZEPVidWidget&) = delete;

  // Calls iHandler for each iEvent this widget raises; keeps a reference to it.
  void AddHandler(const ZEPSYPEvent& iEvent, ZEPSYPEventHandler* iHandler, int iFlag);
  // Host side: calls the handlers of iEvent in order, with iArgs (may be null).
  void Raise(const ZEPSYPEvent& iEvent, ZEPSYPEventArgs* iArgs);
  int HandlerCount(const ZEPSYPEvent& iEvent) const;
  std::uint64_t GetSerial() const { return _serial; }
  static bool IsAlive(const ZEPVidWidget* iWidget, std::uint64_t iSerial);

private:
  struct Subscription {
    ZEPSYPEvent event;
    ZEPSYPEventHandler* handler;
  };
  std::vector<Subscription> _handlers;
  std::uint64_t _serial;
};

class ZEPVidFraWindow : public ZEPVidWidget {
  ZEP_DECLARE_CLASS
public:
  ~ZEPVidFraWindow() override;
  // The content widget of the window (the panel of a custom list dialog); may be null.
  ZEPVidWidget* GetApplicativeWidget() const { return _pContent; }
  void SetLifeCycle(int iLifeCycle) { _lifeCycle = iLifeCycle; }
  int GetLifeCycle() const { return _lifeCycle; }
  void SetVisibleFlag(int iVisible) { _visible = iVisible != 0; }
  bool IsVisible() const { return _visible; }
  // Destroyed at the next idle time.
  void RequestDelayedDestruction() { _destructionRequested = true; }
  bool IsDestructionRequested() const { return _destructionRequested; }
  // The command the window was created for; null once that command is gone.
  ZEPCommand* GetParentCommand() const;
  const std::string& GetName() const { return _name; }

  // Raised when the window ends on its own (its host-side accept, or a reject nobody handled).
  static const ZEPSYPEvent& Closed();

  // The windows not yet destroyed, oldest first.
  static std::vector<ZEPVidFraWindow*> Windows();
  static void RunDelayedDestructions();

protected:
  ZEPVidFraWindow(ZEPCommand* iParent, const std::string& iName);
  void SetApplicativeWidget(ZEPVidWidget* iContent) { _pContent = iContent; }
  // Hides the window, asks for its destruction and raises Closed.
  void CloseItself();

private:
  friend class ZEPDlgDriver;
  ZEPBaseUnknown_WR _parent;
  std::string _name;
  ZEPVidWidget* _pContent = nullptr; // owned
  int _lifeCycle = 0;
  bool _visible = false;
  bool _destructionRequested = false;
};

class ZEPVidFraDialog : public ZEPVidFraWindow {
  ZEP_DECLARE_CLASS
public:
  static const ZEPSYPEvent& RejectButtonClicked();
  // What the dialog's accept button does on the host's side; the base does nothing.
  virtual void OnAccept() {}

protected:
  ZEPVidFraDialog(ZEPCommand* iParent, const std::string& iName)
      : ZEPVidFraWindow(iParent, iName) {}
};

// The custom sort lists of tables: the panel of the dialog that edits them.
class ZEPDbsManageCustomListVID : public ZEPVidWidget {
  ZEP_DECLARE_CLASS
public:
  // A new dialog whose applicative widget is the panel; null when the host cannot create it.
  static ZEPVidFraDialog* CreateCustomListDialog(ZEPCommand* iParent);
  static const ZEPSYPEvent& AcceptBtnPressed();
  static const ZEPSYPEvent& CancelBtnPressed();
  // Reads the custom lists the user and the administrator defined.
  void BuildFromPreferencesAndSettings();
  bool IsBuilt() const { return _built; }
  const std::vector<std::string>& GetLists() const { return _lists; }

private:
  bool _built = false;
  std::vector<std::string> _lists;
};

// The legend table layout dialog, opened for a context the page supplies.
class ZEPDbsLegendTableLayoutVID : public ZEPVidFraDialog {
  ZEP_DECLARE_CLASS
public:
  static ZEPVidFraDialog* CreateLegendTableLayoutDialog(ZEPCommand* iParent,
                                                        const ZEPString& iContext);
  const ZEPString& GetContext() const { return _context; }
  // Accepting applies the layout and ends the dialog on the host's side.
  void OnAccept() override { CloseItself(); }

private:
  ZEPDbsLegendTableLayoutVID(ZEPCommand* iParent, const ZEPString& iContext);
  ZEPString _context;
};

// Configuration of the newer dialogs, for the application and for tests.
class ZEPVidSetup {
public:
  // The factories answer null.
  static void SetCustomListFactoryFails(bool iFails);
  static void SetLegendFactoryFails(bool iFails);
  // The custom list dialog's applicative widget is not the panel.
  static void SetCustomListContentIsNotPanel(bool iNotPanel);
  // Events are raised without arguments.
  static void SetEventsWithoutArgs(bool iWithout);
  static bool EventsWithoutArgs();
  // The lists BuildFromPreferencesAndSettings finds.
  static void SetCustomLists(const std::vector<std::string>& iLists);
  static std::vector<std::string> GetCustomLists();
  // Destroys every window and restores the defaults.
  static void Reset();
};
