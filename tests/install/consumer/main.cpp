// The general page in an application of its own: the view frame setting lives in a variable, the
// user ticks it, the page writes it back. Prints the page and the value; fails on any surprise.
#include "ZEP2DBaseOptGalFrm.h"

#include <cstdio>
#include <cstdlib>

namespace {
class GeneralPage : public ZEP2DBaseOptGalFrm {
public:
  explicit GeneralPage(ZEPDialog* iParent) : ZEP2DBaseOptGalFrm(iParent, "GeneralPage") {}
  unsigned char viewFrame = 0;

protected:
  long SetSysViewFrame(const unsigned char& iValue) override {
    viewFrame = iValue;
    return S_OK;
  }
  long GetSysViewFrame(unsigned char& oValue) override {
    oValue = viewFrame;
    return S_OK;
  }
  long GetSysViewFrameInfo(ZEPSettingInfo& oInfo) override {
    oInfo.Reset();
    return S_OK;
  }
};
} // namespace

int main() {
  setenv("ZEP_RESOURCES", CONSUMER_RESOURCES, 0);
  ZEPSysSettingRepository::Open("DraftingOptions");
  ZEPDlgWindow root(nullptr, "root", 0);
  auto* page = new GeneralPage(&root);
  page->Build();
  page->Initialize();
  ZEPDialog* check = ZEPDlgDriver::FindControl(page, "checkViewFrame");
  if (!check || !ZEPDlgDriver::Click(check) || page->viewFrame != 1) {
    std::fprintf(stderr, "the view frame check did not write its setting\n");
    return 1;
  }
  if (check->GetTitle().IsEmpty()) {
    std::fprintf(stderr, "no catalog texts under %s\n", CONSUMER_RESOURCES);
    return 1;
  }
  std::printf("%s", ZEPDlgDriver::Dump(page).c_str());
  return 0;
}
