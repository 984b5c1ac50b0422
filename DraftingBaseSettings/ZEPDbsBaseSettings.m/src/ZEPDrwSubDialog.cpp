#include "ZEPDrwSubDialog.h"

ZEPDrwSubDialog::ZEPDrwSubDialog(const ZEPString& iName, unsigned long iStyle)
    : _name(iName), _style(iStyle) {}

ZEPDrwSubDialog::~ZEPDrwSubDialog() { _pDialog = nullptr; }

ZEPDlgDialog* ZEPDrwSubDialog::OpenDialog(ZEPDialog* iPage, const Builder& iBuild,
                                          Callback iClose) {
  if (_pDialog) {
    _pDialog->SetVisibility(ZEPDlgShow);
    return nullptr;
  }
  if (!iPage) return nullptr;
  _pDialog = new ZEPDlgDialog(iPage, _name, _style);
  ZEPSettingInfo info;
  iBuild(_pDialog, info);
  _pDialog->SetVisibility(ZEPDlgShow);
  AddCallback(_pDialog, _pDialog->GetDiaCLOSENotification(), iClose, nullptr);
  AddCallback(_pDialog, _pDialog->GetWindCloseNotification(), std::move(iClose), nullptr);
  return _pDialog;
}

bool ZEPDrwSubDialog::Close(ZEPCommand* iSender) {
  if (!_pDialog || iSender != _pDialog) return false;
  _pDialog->RequestDelayedDestruction();
  _pDialog = nullptr;
  for (const auto& clear : _clearers)
    clear();
  return true;
}
