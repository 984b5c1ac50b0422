// The dialog toolkit: commands, notifications and the widget tree.
//
// Headless and single-threaded. Widgets are tree nodes: a widget is created with its
// parent and owned by it; destroying a parent destroys its children. Programmatic setters
// never raise notifications; only the user (ZEPDlgDriver) does.
#pragma once

#include "ZEPSystem.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <vector>

// Toolkit constants.
enum : unsigned long { ZEPDlgEnable = 8, ZEPDlgDisable = 16 };
enum : unsigned long { ZEPDlgShow = 2, ZEPDlgHide = 4 };
enum : unsigned long { ZEPDlgChecked = 0x40000, ZEPDlgUnchecked = 0x80000 };
#define ZEPDlgSpnDouble 0x20000UL

// Toolkit magnitudes and units of value controls (the numbering is the toolkit's).
using ZEPDlgMagnitude = int;
using ZEPDlgUnit = int;

class ZEPCommand;
class ZEPDialog;
class ZEPDlgLock;

class ZEPNotification : public ZEPBaseUnknown {
  ZEP_DECLARE_CLASS
public:
  ZEPNotification(ZEPCommand* iOwner, std::string iKind) : _pOwner(iOwner), _kind(std::move(iKind)) {}
  ZEPCommand* GetOwner() const { return _pOwner; }
  const std::string& GetKind() const { return _kind; }
  // 1 when iOther is this very notification object, else 0.
  int IsEqual(const ZEPNotification* iOther) const { return iOther == this ? 1 : 0; }

private:
  ZEPCommand* _pOwner;
  std::string _kind;
};

// A combo's list opens (drop) or closes (close-up).
class ZEPDlgComboDropNotification : public ZEPNotification {
  ZEP_DECLARE_CLASS
public:
  using ZEPNotification::ZEPNotification;
};
class ZEPDlgComboCloseUpNotification : public ZEPNotification {
  ZEP_DECLARE_CLASS
public:
  using ZEPNotification::ZEPNotification;
};

class ZEPCommand : public ZEPBaseUnknown {
  ZEP_DECLARE_CLASS
public:
  using Callback = std::function<void(ZEPCommand*, ZEPNotification*, void*)>;

  ZEPCommand();
  ~ZEPCommand() override;
  ZEPCommand(const ZEPCommand&) = delete;
  ZEPCommand& operator=(const ZEPCommand&) = delete;

  // The command that receives the notifications this one does not analyse: the one given to
  // SetFather while it lives, else none.
  virtual ZEPCommand* GetFather() const;
  // A father that is destroyed first is forgotten, never reached.
  void SetFather(ZEPCommand* iFather);

  // Identity of this command for references that must notice its end (see IsLive).
  std::uint64_t GetSerial() const { return _serial; }
  // True while the command of that serial lives at that address.
  static bool IsLive(const ZEPCommand* iCommand, std::uint64_t iSerial);

  // Sends iNotif from this command: the callbacks registered for it on this command run,
  // then those on each father in turn, each with the command it was registered on as sender.
  void SendNotification(ZEPNotification* iNotif);

  // Runs the callbacks registered on this command for iNotif as if iApparentSender had sent
  // it: how tests and tools check that a callback ignores what is not its own control.
  void DeliverAs(ZEPNotification* iNotif, ZEPCommand* iApparentSender);

  // A notification object owned by this command, created on first use.
  ZEPNotification* OwnNotification(const char* iKind);
  // The same, of a notification class of its own (for ZEPSysDynamicCast by the receiver).
  template <class T> T* OwnTypedNotification(const char* iKind) {
    for (auto& n : _notifications)
      if (n->GetKind() == iKind) return ZEPSysDynamicCast<T>(n.get());
    _notifications.push_back(std::make_unique<T>(this, iKind));
    return static_cast<T*>(_notifications.back().get());
  }
  // The notification objects created so far.
  std::vector<ZEPNotification*> GetNotifications() const;

protected:
  // Calls iMethod of this object when iSender sends iNotif.
  template <class T>
  void AddAnalyseNotificationCB(ZEPCommand* iSender, ZEPNotification* iNotif,
                                void (T::*iMethod)(ZEPCommand*, ZEPNotification*, void*), void* iData) {
    T* self = static_cast<T*>(this);
    AddCallback(iSender, iNotif,
                [self, iMethod](ZEPCommand* s, ZEPNotification* n, void* d) { (self->*iMethod)(s, n, d); },
                iData);
  }
  void AddCallback(ZEPCommand* iSender, ZEPNotification* iNotif, Callback iCallback, void* iData);

private:
  struct Subscription {
    ZEPNotification* notif;
    ZEPCommand* subscriber;
    std::uint64_t subscriberSerial;
    Callback callback;
    void* data;
  };
  struct Sender {
    ZEPCommand* sender;
    std::uint64_t serial;
  };
  void RunCallbacks(ZEPNotification* iNotif, ZEPCommand* iSender);

  std::uint64_t _serial;
  ZEPCommand* _pFather = nullptr;
  std::uint64_t _fatherSerial = 0;
  std::vector<Subscription> _subscriptions; // callbacks registered on this command
  std::vector<Sender> _senders;             // commands this one subscribed to
  std::vector<std::unique_ptr<ZEPNotification>> _notifications;
};

// Rectangle of a window, in pixels.
struct ZEPRect {
  int x = 0, y = 0, dx = 0, dy = 0;
};

class ZEPDialog : public ZEPCommand {
  ZEP_DECLARE_CLASS
public:
  struct Cell {
    bool set = false;
    short row = 0, column = 0, width = 1, height = 1;
    unsigned int justification = 0;
  };

  ZEPDialog(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle);
  ~ZEPDialog() override;

  // The father given to SetFather, else the parent widget.
  ZEPCommand* GetFather() const override {
    ZEPCommand* father = ZEPCommand::GetFather();
    return father ? father : _pParent;
  }
  ZEPDialog* GetParentDialog() const { return _pParent; }
  const std::vector<ZEPDialog*>& GetChildren() const { return _children; }

  virtual ZEPString GetName() const { return _name; }
  // The name the widget was constructed with, whatever GetName answers.
  const ZEPString& GetOwnName() const { return _name; }
  // Message catalog chain: index 0 is the class's own catalog; empty when none. The same for
  // every instance of a class: the toolkit looks it up once per class.
  virtual ZEPString GetResourceFilename(int iIndex = 0) const;

  unsigned long GetStyle() const { return _style; }

  void SetGridConstraints(short iRow, short iColumn, short iWidth, short iHeight, unsigned int iJustification);
  const Cell& GetGridConstraints() const { return _cell; }
  void SetGridColumnResizable(int iColumn, int iFlag = 1);
  void SetGridRowResizable(int iRow, int iFlag = 1);

  void SetSensitivity(unsigned long iSensitivity);
  unsigned long GetSensitivity() const { return _sensitivity; }
  void SetVisibility(unsigned long iVisibility) { _visibility = iVisibility; }
  unsigned long GetVisibility() const { return _visibility; }
  // Enabled and shown, and so are all its ancestors: what the user can operate.
  bool IsEffectivelyEnabled() const;

  void SetTitle(const ZEPUnicodeString& iText) { _title = iText; }
  void SetHelp(const ZEPUnicodeString& iText) { _help = iText; }
  void SetShortHelp(const ZEPUnicodeString& iText) { _shortHelp = iText; }
  void SetLongHelp(const ZEPUnicodeString& iText) { _longHelp = iText; }
  const ZEPUnicodeString& GetTitle() const { return _title; }
  const ZEPUnicodeString& GetHelp() const { return _help; }
  const ZEPUnicodeString& GetShortHelp() const { return _shortHelp; }
  const ZEPUnicodeString& GetLongHelp() const { return _longHelp; }

  void SetIconName(const ZEPString& iNormal, const ZEPString& iSelected = "", const ZEPString& iFocused = "",
                   const ZEPString& iDisabled = "", short iFlag = 0);
  const ZEPString& GetIconName() const { return _icon; }

  // The padlock that governs this widget's sensitivity; null if none.
  ZEPDlgLock* GetGoverningLock() const { return _pGoverningLock; }

  // Destroys the widget at the next idle time (ZEPDlgDriver::Idle).
  void RequestDelayedDestruction();
  static void RunDelayedDestructions();

  // Short kind for dumps ("frame", "check", ...) and the widget's state as " key=value" text.
  virtual const char* KindName() const { return "widget"; }
  virtual void DumpState(std::string& ioOut) const { (void)ioOut; }

private:
  friend class ZEPDlgLock;
  void LoadCatalogTexts();

  ZEPDialog* _pParent;
  std::vector<ZEPDialog*> _children;
  ZEPString _name;
  unsigned long _style;
  Cell _cell;
  unsigned long _sensitivity = ZEPDlgEnable;
  unsigned long _visibility = ZEPDlgShow;
  ZEPUnicodeString _title, _help, _shortHelp, _longHelp;
  ZEPString _icon;
  ZEPDlgLock* _pGoverningLock = nullptr; // padlock that keeps this widget disabled while locked
};

// ---- containers ----------------------------------------------------------------------------
class ZEPDlgFrame : public ZEPDialog {
  ZEP_DECLARE_CLASS
public:
  ZEPDlgFrame(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle = 0x80001);
  const char* KindName() const override { return "frame"; }
};

// A titled page section; its controls go into GetOptionsFrame.
class ZEPDlgToolsOptionsFrame : public ZEPDlgFrame {
  ZEP_DECLARE_CLASS
public:
  ZEPDlgToolsOptionsFrame(ZEPDialog* iParent, const ZEPString& iName, const ZEPString& iIconName,
                          unsigned long iStyle);
  virtual ZEPDlgFrame* GetOptionsFrame() { return _pOptions; }
  const char* KindName() const override { return "section"; }

private:
  ZEPDlgFrame* _pOptions;
};

class ZEPDlgContainer : public ZEPDlgFrame {
  ZEP_DECLARE_CLASS
public:
  ZEPDlgContainer(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle = 0);
  const char* KindName() const override { return "container"; }
};

class ZEPDlgWindow : public ZEPDialog {
  ZEP_DECLARE_CLASS
public:
  ZEPDlgWindow(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle = 0);
  ZEPNotification* GetWindCloseNotification() { return OwnNotification("WindClose"); }
  void GetRectDimensions(ZEPRect* oRect) const;
  void SetRectDimensions(const ZEPRect& iRect, int iFlag = 0);
  const char* KindName() const override { return "window"; }

private:
  ZEPRect _rect{0, 0, 400, 300};
};

class ZEPDlgDialog : public ZEPDlgWindow {
  ZEP_DECLARE_CLASS
public:
  ZEPDlgDialog(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle = 0x11440201);
  ZEPNotification* GetDiaCLOSENotification() { return OwnNotification("DiaCLOSE"); }
  const char* KindName() const override { return "dialog"; }
};

// ---- buttons and labels ------------------------------------------------------------------------
class ZEPDlgCheckButton : public ZEPDialog {
  ZEP_DECLARE_CLASS
public:
  ZEPDlgCheckButton(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle = 0);
  unsigned long GetState() const { return _state; }
  void SetState(unsigned long iState, int iNotify = 1);
  ZEPNotification* GetChkBModifyNotification() { return OwnNotification("ChkBModify"); }
  ZEPNotification* GetChkBDoubleClickNotification() { return OwnNotification("ChkBDoubleClick"); }
  const char* KindName() const override { return "check"; }
  void DumpState(std::string& ioOut) const override;

private:
  unsigned long _state = ZEPDlgUnchecked;
};

// Radio buttons with the same parent form one group: turning one on turns the others off.
class ZEPDlgRadioButton : public ZEPDialog {
  ZEP_DECLARE_CLASS
public:
  ZEPDlgRadioButton(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle = 0);
  unsigned long GetState() const { return _state; }
  void SetState(unsigned long iState, int iNotify = 1);
  ZEPNotification* GetRadBModifyNotification() { return OwnNotification("RadBModify"); }
  // The radio of the same group that is on, other than this one; null if none.
  ZEPDlgRadioButton* GetOtherOn() const;
  const char* KindName() const override { return "radio"; }
  void DumpState(std::string& ioOut) const override;

private:
  unsigned long _state = ZEPDlgUnchecked;
};

class ZEPDlgPushButton : public ZEPDialog {
  ZEP_DECLARE_CLASS
public:
  ZEPDlgPushButton(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle = 0);
  ZEPNotification* GetPushBActivateNotification() { return OwnNotification("PushBActivate"); }
  const char* KindName() const override { return "push"; }
};

class ZEPDlgLabel : public ZEPDialog {
  ZEP_DECLARE_CLASS
public:
  ZEPDlgLabel(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle = 0);
  const char* KindName() const override { return "label"; }
};

// ---- combos ------------------------------------------------------------------------------------
class ZEPDlgCombo : public ZEPDialog {
  ZEP_DECLARE_CLASS
public:
  ZEPDlgCombo(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle = 0x40000);

  // Adds a line at iIndex (-1: at the end); answers its index.
  int SetLine(const ZEPUnicodeString& iText, int iIndex = -1, unsigned int iFlags = 0x40);
  int SetLine(const ZEPUnicodeString& iText, const ZEPString& iIconName, int iIndex = -1, unsigned int iFlags = 0x40);
  void ClearLine();
  int GetLineCount() const { return static_cast<int>(_lines.size()); }
  // Answers the index selected, -1 when there is no such line (the selection is kept).
  int SetSelect(int iIndex, int iNotify = 1);
  int SetSelect(const ZEPUnicodeString& iText, int iNotify = 1);
  int GetSelect() const { return _selected; }
  // The text of line iIndex; empty and -1 when there is none.
  int GetLine(ZEPUnicodeString& oText, int iIndex) const;
  // The icon name of line iIndex (empty for a line without icon); empty and -1 when there is
  // no such line.
  int GetLineIconName(ZEPString& oIconName, int iIndex) const;
  void ClearSelect() { _selected = -1; }
  void SetVisibleTextWidth(int iWidth) { _textWidth = iWidth; }
  void SetVisibleTextHeight(int iHeight) { _textHeight = iHeight; }
  int GetVisibleTextWidth() const { return _textWidth; }
  int GetVisibleTextHeight() const { return _textHeight; }
  ZEPNotification* GetComboSelectNotification() { return OwnNotification("ComboSelect"); }
  ZEPNotification* GetComboDropNotification() {
    return OwnTypedNotification<ZEPDlgComboDropNotification>("ComboDrop");
  }
  ZEPNotification* GetComboCloseUpNotification() {
    return OwnTypedNotification<ZEPDlgComboCloseUpNotification>("ComboCloseUp");
  }
  const char* KindName() const override { return "combo"; }
  void DumpState(std::string& ioOut) const override;

private:
  struct Line {
    ZEPUnicodeString text;
    ZEPString icon;
  };
  std::vector<Line> _lines;
  int _selected = -1;
  int _textWidth = 0, _textHeight = 0;
};

// Application combos: a frame around a combo whose lines are numbered entries from 1.
class ZEPNumberedCombo : public ZEPDlgFrame {
  ZEP_DECLARE_CLASS
public:
  ZEPDlgCombo* GetCombo() const { return _pCombo; }
  // Number of the selected entry; 0 when none is selected.
  unsigned int GetSelect() const;
  void SetSelect(unsigned int iNumber);
  // Adds an entry after the others; its number is the new line count.
  void AddOtherType(const ZEPString& iIconName, int iFlag);
  void DumpState(std::string& ioOut) const override;

protected:
  ZEPNumberedCombo(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle, const char* iEntryWord,
                   int iEntries, unsigned int iInitial);

private:
  ZEPDlgCombo* _pCombo;
};

class ZEPComboDashed : public ZEPNumberedCombo {
  ZEP_DECLARE_CLASS
public:
  // Seven line types; iValue is the type selected at first.
  ZEPComboDashed(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle, unsigned int iValue, int iFlag);
  const char* KindName() const override { return "linetype"; }
};

class ZEPComboWeight : public ZEPNumberedCombo {
  ZEP_DECLARE_CLASS
public:
  // Eight line weights; iValue is the weight selected at first.
  ZEPComboWeight(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle, unsigned int iValue, int iFlag);
  const char* KindName() const override { return "weight"; }
};

class ZEPComboSymbol : public ZEPNumberedCombo {
  ZEP_DECLARE_CLASS
public:
  // Twelve symbols; iValue is the symbol selected at first.
  ZEPComboSymbol(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle, unsigned int iValue, int iFlag);
  unsigned int GetSelectedSymbol(unsigned int& oSymbol) const;
  const char* KindName() const override { return "symbol"; }
};

// Colour combo: named colours plus any colour set through SetSelectedColor.
class ZEPComboColor : public ZEPDlgFrame {
  ZEP_DECLARE_CLASS
public:
  // iRed, iGreen, iBlue: the colour shown at first; the last three are the toolkit's.
  ZEPComboColor(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle, unsigned int iRed,
                unsigned int iGreen, unsigned int iBlue, int, int, int);
  ZEPDlgCombo* GetCombo() const { return _pCombo; }
  // The inner combo's selection notification: it reaches callbacks registered on this combo
  // too, with this combo as the sender, so a page can subscribe here.
  ZEPNotification* GetComboSelectNotification() { return _pCombo->GetComboSelectNotification(); }
  // 1 and the colour when one is selected, else 0 with the outputs untouched.
  int GetSelectedColor(unsigned int* oRed, unsigned int* oGreen, unsigned int* oBlue) const;
  int GetSelectedColor(unsigned int* oRed, unsigned int* oGreen, unsigned int* oBlue, ZEPUnicodeString* oName) const;
  void SetSelectedColor(unsigned int iRed, unsigned int iGreen, unsigned int iBlue);
  const char* KindName() const override { return "colour"; }
  void DumpState(std::string& ioOut) const override;

private:
  ZEPDlgCombo* _pCombo;
  unsigned int _rgb[3] = {0, 0, 0};
  bool _hasColor = false;
};

// ---- value controls ----------------------------------------------------------------------------
// Base of the controls that hold a value with a magnitude and a unit.
class ZEPDlgControl : public ZEPDialog {
  ZEP_DECLARE_CLASS
public:
  void SetMagnitude(ZEPDlgMagnitude iMagnitude) { _magnitude = iMagnitude; }
  void SetUnit(ZEPDlgUnit iUnit) { _unit = iUnit; }
  void SetPrecision(int iPrecision, unsigned char iFlag = 0) {
    _precision = iPrecision;
    (void)iFlag;
  }
  ZEPDlgMagnitude GetMagnitude() const { return _magnitude; }
  ZEPDlgUnit GetUnit() const { return _unit; }
  int GetPrecision() const { return _precision; }

  // The display form of an internal value (metres, radians) in the control's unit.
  double ToDisplay(double iValue) const;
  double FromDisplay(double iDisplayed) const;
  // The unit's short symbol ("mm", "deg"); empty for a plain number.
  std::string UnitSymbol() const;
  // The value as shown: display unit, precision, symbol.
  std::string FormatValue(double iValue) const;

protected:
  ZEPDlgControl(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle);

private:
  ZEPDlgMagnitude _magnitude = 0;
  ZEPDlgUnit _unit = 0;
  int _precision = 0;
};

class ZEPDlgSpinner : public ZEPDlgControl {
  ZEP_DECLARE_CLASS
public:
  ZEPDlgSpinner(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle = 0x40000);

  void SetRange(float iMin, float iMax, int iSteps, int iFlag = 1);
  void SetRange(float iMin, float iMax, float iStep, int iFlag = 0);
  void GetRange(float& oMin, float& oMax, int& oSteps) const;
  void GetRange(float& oMin, float& oMax, float& oStep) const;
  void SetMinMaxStep(double iMin, double iMax, double iStep, int iFlag = 0);
  void GetMinMaxStep(double& oMin, double& oMax, double& oStep) const;
  bool HasLimits() const { return _hasLimits; }
  // The last argument of the last SetRange or SetMinMaxStep call.
  int GetRangeFlag() const { return _rangeFlag; }

  void SetValue(double iValue, int iNotify = 1) {
    _value = iValue;
    (void)iNotify;
  }
  double GetValue() const { return _value; }
  float SetCurrentValue(float iValue, int iNotify = 1) {
    _value = iValue;
    (void)iNotify;
    return iValue;
  }
  float GetCurrentValue() const { return static_cast<float>(_value); }
  // The value brought within the limits, when there are limits.
  double Clamp(double iValue) const;

  void SetFormat(const char* iFormat) { _format = iFormat ? iFormat : ""; }
  const char* GetFormat() const { return _format.empty() ? nullptr : _format.c_str(); }
  void SetVisibleTextWidth(int iWidth) { _textWidth = iWidth; }
  int GetVisibleTextWidth() const { return _textWidth; }
  ZEPNotification* GetSpinnerModifyNotification() { return OwnNotification("SpinnerModify"); }
  const char* KindName() const override { return "spinner"; }
  void DumpState(std::string& ioOut) const override;

private:
  double _value = 0.0;
  double _min = 0.0, _max = 0.0, _step = 1.0;
  bool _hasLimits = false;
  int _rangeFlag = 0;
  std::string _format;
  int _textWidth = 0;
};

class ZEPDlgEditor : public ZEPDlgControl {
  ZEP_DECLARE_CLASS
public:
  ZEPDlgEditor(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle = 0);
  void SetText(const ZEPUnicodeString& iText, int iNotify = 1) {
    _text = iText;
    (void)iNotify;
  }
  const ZEPUnicodeString& GetText() const { return _text; }
  void SetValue(double iValue, int iNotify = 1);
  void SetVisibleTextWidth(int iWidth) { _textWidth = iWidth; }
  ZEPNotification* GetEditModifyNotification() { return OwnNotification("EditModify"); }
  const char* KindName() const override { return "editor"; }
  void DumpState(std::string& ioOut) const override;

private:
  ZEPUnicodeString _text;
  int _textWidth = 0;
};

class ZEPDlgSlider : public ZEPDialog {
  ZEP_DECLARE_CLASS
public:
  ZEPDlgSlider(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle = 0);
  void SetRange(float iMin, float iMax, int iSteps);
  float SetCurrentValue(float iValue, int iNotify = 1);
  float GetCurrentValue() const { return _value; }
  float GetMin() const { return _min; }
  float GetMax() const { return _max; }
  ZEPNotification* GetSliderDragNotification() { return OwnNotification("SliderDrag"); }
  const char* KindName() const override { return "slider"; }
  void DumpState(std::string& ioOut) const override;

private:
  float _min = 0.f, _max = 100.f, _value = 0.f;
  int _steps = 100;
};

class ZEPDlgIconBox : public ZEPDialog {
  ZEP_DECLARE_CLASS
public:
  ZEPDlgIconBox(ZEPDialog* iParent, const ZEPString& iName, unsigned long iStyle = 0);
  void AddIcon(const ZEPString& iIconName) { _icons.push_back(iIconName); }
  int GetIconCount() const { return static_cast<int>(_icons.size()); }
  // Answers the index selected, or -1 when there is no such entry.
  int SetSelect(int iIndex, int iNotify = 1);
  int SetSelect(const ZEPString& iIconName, int iNotify = 1);
  int GetSelect() const { return _selected; }
  ZEPNotification* GetIBoxSelectNotification() { return OwnNotification("IBoxSelect"); }
  const char* KindName() const override { return "iconbox"; }
  void DumpState(std::string& ioOut) const override;

private:
  std::vector<ZEPString> _icons;
  int _selected = -1;
};
