// Demo until the application exists: a lock-aware control on a frame, dumped.
#include "ZEPDrwLockCheckButton.h"
#include "ZEPDrwLockSpinner.h"

#include <iostream>

int main() {
  ZEPDlgWindow root(nullptr, "DraftingOptions", 0);
  ZEPSettingInfo info;
  auto* grid = new ZEPDrwLockCheckButton(&root, "checkGrid", info, 0);
  grid->SetGridConstraints(0, 0, 1, 1, 0x1E);
  info.SetLocked(true);
  info.SetLockText("admin, in the administrator's settings");
  auto* spacing = new ZEPDrwLockSpinner(&root, "editorGridSpacing", info, 0x60000);
  spacing->SetGridConstraints(1, 0, 1, 1, 0x1E);
  spacing->SetValue(0.1, 0);
  std::cout << ZEPDlgDriver::Dump(&root);
  return 0;
}
