// Dimension options page: creating dimensions (following the cursor, line position, 3D
// associativity in a sub-dialog, driving dimensions and chamfers, circles), moving them, lining
// them up, and the origin symbol of oriented dimensions.
//
// Unlike the other pages, this class is registered with the host object model.
#pragma once

#include "ZEPDrwSettingHooks.h"
#include "ZEPDrwSubDialog.h"

class ZEPDrwLockCheckButton;
class ZEPDrwLockDialog;
class ZEPDrwLockSpinner;

class ZEP2DBaseOptDimFrm : public ZEPDlgFrame {
public:
  // Object model: "ZEP2DBaseOptDimFrm", an implementation of ZEPDlgFrame in the
  // DraftingBaseSettings framework, registered on first use. Its factory makes nothing: only a
  // hosting subclass creates the page.
  static const ZEPMetaObject* MetaObject();
  const ZEPMetaObject* GetMetaObject() const override;
  static const char* ClassId();
  static const char* ClassName();

  ~ZEP2DBaseOptDimFrm() override;
  ZEPString GetResourceFilename(int iIndex = 0) const override;
  void Build();
  void Initialize();

protected:
  ZEP2DBaseOptDimFrm(ZEPDialog* iParent, const ZEPString& iName);

  // Layout options, asked once by Build; the hosting application may override them.
  // The section part with the driving dimension and chamfer checks (default: true).
  virtual unsigned char WithFrmCreateDriveAndChamfer();
  // The base offset and offset spinners of the line-up section (default: true).
  virtual unsigned char WithLineUpValues();
  // The oriented dimension section with the origin symbol check (default: false).
  virtual unsigned char WithFrmDimOrigin();

#define ZEP_SETTING(Name, Kind) ZEP_DECLARE_SETTING_HOOKS(Name, Kind)
#include "ZEP2DBaseOptDimFrm.def"
#undef ZEP_SETTING

private:
  static ZEPBaseUnknown* CreateItself();
  static const ZEPMetaObject* _pMetaObject;

  void UpdateWidgets();
  void Write(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData);
  void NotifPush(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData);
  void BuildDlgAssoc3D(ZEPDlgDialog* iDialog, ZEPSettingInfo& ioInfo);
  void CloseDlg(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData);
  // Sensitivity of a dependent control, when it exists: enabled (8) when iEnabled, else
  // disabled (16); a padlock keeps a locked one disabled.
  static void Enable(ZEPDrwLockDialog* iControl, bool iEnabled);

  // Page controls; null until Build, and optional ones may stay null.
  ZEPDrwLockCheckButton* _pChkDimSketch = nullptr;
  ZEPDrwLockCheckButton* _pChkDimLinePosRelative = nullptr;
  ZEPDrwLockSpinner* _pSpnDimLinePosValue = nullptr;
  ZEPDlgPushButton* _pPushAssoc3D = nullptr;
  ZEPDrwLockCheckButton* _pChkDimDriveAuto = nullptr;
  ZEPDrwLockCheckButton* _pChkDetectChamfer = nullptr;
  ZEPDlgRadioButton* _pRadCircleCenter = nullptr;
  ZEPDlgRadioButton* _pRadCircleEdge = nullptr;
  ZEPDrwLockCheckButton* _pChkActivateSnapBetSymbols = nullptr;
  ZEPDrwLockCheckButton* _pChkMoveSubPart = nullptr;
  ZEPDrwLockSpinner* _pSpnBaseOffsetLength = nullptr;
  ZEPDrwLockSpinner* _pSpnBaseOffsetAngle = nullptr;
  ZEPDrwLockSpinner* _pSpnOffsetLength = nullptr;
  ZEPDrwLockSpinner* _pSpnOffsetAngle = nullptr;
  ZEPDrwLockCheckButton* _pChkLineUpStackVal = nullptr;
  ZEPDrwLockCheckButton* _pChkLineUpCumulVal = nullptr;
  ZEPDrwLockCheckButton* _pChkLineUpAutoFunnel = nullptr;
  ZEPDrwLockCheckButton* _pChkDimOriginSymb = nullptr;

  // The 3D associativity dialog "dimAssocWnd" and its controls, null while it is closed.
  ZEPDrwSubDialog _dlgAssoc3D{"dimAssocWnd"};
  ZEPDlgRadioButton* _pRadForce2DAlways = nullptr;
  ZEPDlgRadioButton* _pRadForce2DWhenPb = nullptr;
  ZEPDlgRadioButton* _pRadForce2DNever = nullptr;
  ZEPDrwLockCheckButton* _pChkAssocDimOnApproximate = nullptr;

  // Cached setting values: lengths in millimetres, angles in degrees.
  double _dDimConstantOffsetValue = 0.0;
  double _dDimOffsetRefMM = 0.0;
  double _dDimOffsetRefDeg = 0.0;
  double _dDimOffsetBetMM = 0.0;
  double _dDimOffsetBetDeg = 0.0;
  int _iDimAssoc3DMod = 0;
  int _iDimCreateCircle = 0;
  unsigned char _bDimFollowMouse = 0;
  unsigned char _bDimConstantOffset = 0;
  unsigned char _bAssocDimOnApproximate = 0;
  unsigned char _bDimCreateDrive = 0;
  unsigned char _bDimDetectChamfer = 0;
  unsigned char _bDimActivateSnapBetSymbols = 0;
  unsigned char _bDimMoveSubPart = 0;
  unsigned char _bDimAlignStackValue = 0;
  unsigned char _bDimAlignCumulValue = 0;
  unsigned char _bDimCumulAddFunnel = 0;
  unsigned char _bDimOriginSymb = 0;
};
