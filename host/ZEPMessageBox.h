// Message boxes of the newer dialog framework: a window that shows a title, an informative
// text, an action icon and standard buttons, and closes itself once answered when asked to.
//
// Headless: a box is on screen from the moment it is made visible until it is answered (the
// user, through Answer) or destroyed. Tests and the application see the boxes on screen and
// count those shown through ZEPMessageBoxSetup.
#pragma once

#include "ZEPDialog.h"

#include <vector>

class ZEPVidFraMessageBox : public ZEPDlgWindow {
  ZEP_DECLARE_CLASS
public:
  ZEPVidFraMessageBox(ZEPDialog* iParent, const ZEPString& iName);
  ~ZEPVidFraMessageBox() override;

  // Buttons as the framework's flags (32: OK).
  void SetStandardButtons(int iButtons) { _buttons = iButtons; }
  void SetEscapeButton(int iButton) { _escape = iButton; }
  void SetDefaultButton(int iButton) { _default = iButton; }
  void SetActionIcon(int iIcon) { _icon = iIcon; }
  void SetActiveFlag(bool iFlag) { _active = iFlag; }
  void SetCompactFlag(bool iFlag) { _compact = iFlag; }
  void SetAutoCloseFlag(bool iFlag) { _autoClose = iFlag; }
  // Shows the box (once: a box answered or hidden is not shown again by this).
  void SetVisibleFlag(bool iFlag);
  void SetModalFlag(bool iFlag) { _modal = iFlag; }
  void SetInformativeText(const ZEPUnicodeString& iText) { _text = iText; }

  int GetStandardButtons() const { return _buttons; }
  int GetEscapeButton() const { return _escape; }
  int GetDefaultButton() const { return _default; }
  int GetActionIcon() const { return _icon; }
  bool IsModal() const { return _modal; }
  bool IsAutoClose() const { return _autoClose; }
  const ZEPUnicodeString& GetInformativeText() const { return _text; }
  // True while shown and not yet answered.
  bool IsOnScreen() const { return _onScreen; }
  // The button that answered the box; 0 while unanswered.
  int GetAnswer() const { return _answer; }

  // The user presses iButton (one of the standard buttons): the box leaves the screen, sends
  // its answer notification and, with auto-close, destroys itself at the next idle time.
  // False, nothing done, when the box is not on screen or has no such button.
  bool Answer(int iButton);
  ZEPNotification* GetAnswerNotification() { return OwnNotification("MsgBoxAnswer"); }

  const char* KindName() const override { return "messagebox"; }
  void DumpState(std::string& ioOut) const override;

private:
  int _buttons = 0, _escape = 0, _default = 0, _icon = 0, _answer = 0;
  bool _active = false, _compact = false, _autoClose = false, _modal = false, _onScreen = false;
  ZEPUnicodeString _text;
};

class ZEPMessageBoxSetup {
public:
  // Boxes made visible since the last Reset, answered or not.
  static int ShownCount();
  // The boxes on screen now, oldest first.
  static std::vector<ZEPVidFraMessageBox*> OnScreen();
  static void Reset();
};
