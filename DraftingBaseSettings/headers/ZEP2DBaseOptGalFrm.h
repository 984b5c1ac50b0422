// General options page: sheet background copy, view frames, the view referential and the
// unit of paper lengths.
#pragma once

#include "ZEPDrwSettingHooks.h"

class ZEPDrwLockCheckButton;
class ZEPDrwLockCombo;
class ZEPDrwLockSpinner;

class ZEP2DBaseOptGalFrm : public ZEPDlgFrame {
public:
  ~ZEP2DBaseOptGalFrm() override;
  ZEPString GetResourceFilename(int iIndex = 0) const override;
  void Build();
  void Initialize();

protected:
  ZEP2DBaseOptGalFrm(ZEPDialog* iParent, const ZEPString& iName);

#define ZEP_SETTING(Name, Kind) ZEP_DECLARE_SETTING_HOOKS(Name, Kind)
#include "ZEP2DBaseOptGalFrm.def"
#undef ZEP_SETTING

private:
  void UpdateWidgets();
  void Write(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData);

  ZEPDrwLockCheckButton* _pChkCopyFirstSheetBckg = nullptr;
  ZEPDrwLockCheckButton* _pChkViewFrame = nullptr;
  ZEPDrwLockCheckButton* _pChkViewReferential = nullptr;
  ZEPDrwLockCheckButton* _pChkViewRefZoom = nullptr;
  ZEPDrwLockSpinner* _pSpnViewAxisSize = nullptr;
  ZEPDrwLockCombo* _pCmbPaperLengthUnit = nullptr;
  double _d2DAxisLength = 0.0;
  int _iPaperLengthUnit = 0;
  unsigned char _b2DAxisDisplay = 0;
  unsigned char _bCopyFirstSheetBckg = 0;
  unsigned char _b2DAxisZoom = 0;
  unsigned char _bViewFrame = 0;
};
