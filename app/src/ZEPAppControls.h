// The controls of an opened page as the user sees them: what each shows, whether it can be
// operated and why not, and how a value typed on the command line becomes a user action.
#pragma once

#include "ZEPHost.h"

#include <string>
#include <vector>

class ZEPDrwLockDialog;

namespace zepapp {

// Exit codes of the application, also the outcome of an operation.
enum ZEPAppExit : int {
  kExitOk = 0,
  kExitFailure = 1,  // something unexpected
  kExitUsage = 2,    // bad command line, unknown page, control or attribute
  kExitRefused = 3,  // locked or disabled control: nothing written
  kExitBadValue = 4, // a value the control does not accept: nothing written
  kExitFile = 5,     // a settings file that cannot be read or written
};

// Choice: radio buttons of one group, chosen by their text. Push: a button that opens a
// sub-dialog or a chooser; it has no value of its own. Editor: a text typed in.
enum class ZEPAppKind { Check, Spinner, Combo, Choice, Push, Editor, Other };

// One control of a page: a lock-aware control, or an operable control without padlock
// (the grid page's scale range combo, a push button), on the page or in a sub-dialog.
struct ZEPAppControl {
  std::string name;                      // "editorGridSpacing"
  ZEPDialog* widget = nullptr;           // the widget of that name
  ZEPDialog* inner = nullptr;            // what the user operates
  ZEPDrwLockDialog* lockAware = nullptr; // null without padlock
  std::string section;                   // title of its section
  ZEPDialog* subDialog = nullptr;        // the sub-dialog it is in; null on the page itself
  ZEPDialog* opener = nullptr;           // the push button that opened that sub-dialog
  bool opensNewerDialog = false;         // a button whose dialog is of the newer framework

  ZEPAppKind Kind() const;
  std::string Title() const;
  // The value as the control shows it: "on"/"off", "100 mm", the selected line.
  std::string Shown() const;
  // Its padlock is closed.
  bool Locked() const;
  // Who locked it and where; empty when not locked.
  std::string LockText() const;
  // The user cannot operate it, locked or not.
  bool Disabled() const;
  // What a value for this control may be, for error messages.
  std::string Accepts() const;
  // What the user picks from: a combo's lines, a group's choices; empty for other kinds.
  std::vector<std::string> ChoiceTexts() const;
};

// A value a button that takes one is offered with: what the user reads, and what to give it.
struct ZEPAppOffer {
  std::string text, value;
};
// What the buttons that take a value offer (adding a PLM standard: the PLM repository's
// standards as the chooser lists them; removing one: the listed PLM standards); empty for
// every other control.
std::vector<ZEPAppOffer> OfferedValues(const std::vector<ZEPAppControl>& iControls, const ZEPAppControl& iControl);

// Every control of a page, in tree order, then those of each sub-dialog that iDialogButtons
// open: each button the user can press is pressed through the driver and its dialog stays
// open. Sub-dialogs opened by an earlier call are closed first, which ends the controls that
// call answered for them.
std::vector<ZEPAppControl> PageControls(ZEPDialog* iPage,
                                        const std::vector<std::string>& iDialogButtons = {});
// Closes the control's sub-dialog as the user does, when it is in one; the dialog is gone
// at the next idle time.
void CloseSubDialog(const ZEPAppControl& iControl);
// By name; an exact match first, else the only case-insensitive one. Null if none.
const ZEPAppControl* FindPageControl(const std::vector<ZEPAppControl>& iControls,
                                     const std::string& iName);

// Why the user cannot operate the control, as a sentence naming who locked it and where, or
// what keeps it disabled; empty when it can be operated.
std::string WhyRefused(const std::vector<ZEPAppControl>& iControls, const ZEPAppControl& iControl);

struct ZEPAppOutcome {
  int code = kExitOk;
  std::string message;  // what happened, or why not
  bool changed = false; // the user action was performed
  std::string warning;  // done, but worth a word (a folder that is not on this computer)
};

// Operates the control with iText as a user would (click, enter, select), or refuses.
ZEPAppOutcome OperateControl(const std::vector<ZEPAppControl>& iControls,
                             const ZEPAppControl& iControl, const std::string& iText);

// A spinner value typed by the user: a number with an optional unit ("25mm", "2.5 cm", "1in",
// "15deg"), in the internal unit of the spinner (metres, radians, plain numbers). False with
// oError when the text or its unit does not fit the spinner.
bool ParseSpinnerValue(const ZEPDlgSpinner& iSpinner, const std::string& iText, double& oInternal,
                       std::string& oError);

// The scale range the grid page's range combo shows, 1 to 5; 0 when there is none.
int ShownRange(const std::vector<ZEPAppControl>& iControls);
// Selects range iRange (1 to 5) in the range combo through the driver.
ZEPAppOutcome SelectRange(const std::vector<ZEPAppControl>& iControls, int iRange);

// Code points of UTF-8 text, for aligned columns.
std::size_t TextWidth(const std::string& iText);

} // namespace zepapp
