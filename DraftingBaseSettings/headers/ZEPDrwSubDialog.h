// One sub-dialog of an options page, opened by a push button of the page: the open dialog
// and the page's pointers to the controls in it.
//
// The page keeps one of these per dialog, tells it which of its pointers point into the
// dialog (Track), opens it from NotifPush (Open) and hands every close notification to it
// from CloseDlg (Close). While the dialog is open, a second press shows it again and creates
// nothing, so the page never loses track of a dialog whose changes it still writes.
#pragma once

#include "ZEPHost.h"

#include <functional>
#include <vector>

class ZEPDrwSubDialog : public ZEPCommand {
public:
  // iName: the dialog's name; iStyle: its toolkit style.
  explicit ZEPDrwSubDialog(const ZEPString& iName, unsigned long iStyle = 0x11440201);
  // Leaves the dialog to the page that owns it.
  ~ZEPDrwSubDialog() override;

  // Pointers of the page that point into the dialog; Close sets each of them to null.
  template <class... T> void Track(T*&... ioPointers) {
    (_clearers.push_back([&ioPointers] { ioPointers = nullptr; }), ...);
  }

  // Opens the dialog as a child of iPage: creates it, lets the page fill it (iBuild, with a
  // setting info record of its own), shows it and has iPage's iClose called for both its close
  // notifications. Answers the new dialog; null when it was open already (it is shown again)
  // or could not be created.
  template <class Page>
  ZEPDlgDialog* Open(Page* iPage, void (Page::*iBuild)(ZEPDlgDialog*, ZEPSettingInfo&),
                     void (Page::*iClose)(ZEPCommand*, ZEPNotification*, void*)) {
    return OpenDialog(
        iPage,
        [iPage, iBuild](ZEPDlgDialog* d, ZEPSettingInfo& info) { (iPage->*iBuild)(d, info); },
        [iPage, iClose](ZEPCommand* s, ZEPNotification* n, void* d) { (iPage->*iClose)(s, n, d); });
  }

  // When iSender is the open dialog: requests its delayed destruction, forgets it, clears every
  // tracked pointer and answers true. Any other sender: false, nothing changes.
  bool Close(ZEPCommand* iSender);

  // The open dialog; null while it is closed.
  ZEPDlgDialog* GetDialog() const { return _pDialog; }

private:
  using Builder = std::function<void(ZEPDlgDialog*, ZEPSettingInfo&)>;
  ZEPDlgDialog* OpenDialog(ZEPDialog* iPage, const Builder& iBuild, Callback iClose);

  ZEPString _name;
  unsigned long _style;
  ZEPDlgDialog* _pDialog = nullptr;
  std::vector<std::function<void()>> _clearers;
};
