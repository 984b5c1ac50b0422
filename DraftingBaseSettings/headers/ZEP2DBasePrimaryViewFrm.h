// Options page of primary view creation: offset between views, plane change after the
// reference selection, view box resizing and 3D grid labels.
#pragma once

#include "ZEPDrwSettingHooks.h"

class ZEPDrwLockCheckButton;
class ZEPDrwLockSpinner;

class ZEP2DBasePrimaryViewFrm : public ZEPDlgFrame {
public:
  ~ZEP2DBasePrimaryViewFrm() override;
  ZEPString GetResourceFilename(int iIndex = 0) const override;
  void Build();
  void Initialize();

protected:
  // The page is always named "PrimaryViewFrame".
  explicit ZEP2DBasePrimaryViewFrm(ZEPDialog* iParent);

#define ZEP_SETTING(Name, Kind) ZEP_DECLARE_SETTING_HOOKS(Name, Kind)
#include "ZEP2DBasePrimaryViewFrm.def"
#undef ZEP_SETTING

  // Icon of the "toolPrimaryView" section, supplied by the hosting application.
  virtual ZEPString GetFrameIconName() = 0;

private:
  void UpdateWidgets();
  void Write(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData);

  ZEPDrwLockCheckButton* _pChkChangePlane = nullptr;
  ZEPDrwLockCheckButton* _pChkResizeViewBox = nullptr;
  ZEPDrwLockCheckButton* _pChkGridLabels = nullptr;
  ZEPDrwLockSpinner* _pSpnDefaultOffset = nullptr;
  double _dDefaultOffset = 0.0;
  unsigned char _bChangePlane = 0;
  unsigned char _bResizeViewBox = 0;
  unsigned char _bManageGridLabels = 0;
};
