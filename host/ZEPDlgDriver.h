// The user at the screen: finds widgets, operates them and reads the screen back.
#pragma once

#include "ZEPDialog.h"

#include <string>

class ZEPVidFraDialog;

// Every action on a widget that is not effectively enabled is refused: nothing changes,
// no notification is sent and the action answers false.
class ZEPDlgDriver {
public:
  // Depth-first, the first widget whose own name is iName; null if none.
  static ZEPDialog* Find(ZEPDialog* iRoot, const ZEPString& iName);
  // The operable widget of a control named iName: its inner control iName + "_dialog"
  // when there is one, else the widget named iName.
  static ZEPDialog* FindControl(ZEPDialog* iRoot, const ZEPString& iName);

  // Check button: toggles. Radio button: selects (the one turned off is notified first).
  // Push button: activates.
  static bool Click(ZEPDialog* iWidget);
  // Spinner: the value in its internal unit (metres, radians), brought within its limits.
  // Slider: the value within its range. Editor: the value as text.
  static bool Enter(ZEPDialog* iWidget, double iValue);
  static bool EnterText(ZEPDialog* iWidget, const ZEPUnicodeString& iText);
  // Combo line (0-based), entry of an application combo, or icon box entry.
  static bool Select(ZEPDialog* iWidget, int iIndex);
  // Opens (drop-down) and closes (close-up) a combo's list; nothing is picked.
  static bool DropDown(ZEPDialog* iWidget);
  static bool CloseUp(ZEPDialog* iWidget);
  static bool SelectColor(ZEPDialog* iWidget, unsigned int iRed, unsigned int iGreen, unsigned int iBlue);
  // The close button of a window's frame (window close notification).
  static bool Close(ZEPDialog* iDialog);
  // The dialog's own Close button (dialog close notification).
  static bool CloseDialog(ZEPDialog* iDialog);
  // Runs the delayed destructions, of toolkit widgets and of newer dialogs.
  static void Idle();

  // Newer dialogs (ZEPVidDialogs.h): the accept, cancel and reject buttons. Refused for a
  // dialog that is hidden or ending.
  static bool Accept(ZEPVidFraDialog* iDialog);
  static bool Cancel(ZEPVidFraDialog* iDialog);
  static bool Reject(ZEPVidFraDialog* iDialog);

  // Why the user cannot operate the widget: "" when it can be operated, else a sentence
  // ("locked by ...", "disabled", "hidden").
  static std::string WhyNotOperable(const ZEPDialog* iWidget);

  // Stable text rendering of a subtree: kind, name, cell, title, value, padlock and state.
  static std::string Dump(const ZEPDialog* iRoot);
};
