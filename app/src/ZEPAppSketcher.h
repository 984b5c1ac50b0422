// The sketcher's settings as the application serves them: the sketcher settings adapter over
// the application's repositories, told of every change made on a page.
#pragma once

#include "ZEP2DBaseSketcherSettingsAdapt.h"
#include "ZEPAppBinding.h"

#include <iosfwd>

namespace zepapp {

class ZEPAppSettingsFile;

// The general repository (creation, completion, drag and general colours) has no page yet;
// the specific one is shared with the grid page, which writes the very attributes the adapter
// reads.
inline constexpr const char* kSketcherGeneralRepository = "DrwSketcherGeneral";
inline constexpr const char* kSketcherSpecificRepository = "DrwSketcherSpecific";

// While an instance lives, each setting a page writes into one of its two repositories sends
// the sketcher's event of that setting, once, after the write; every live instance hears it.
// The repositories must stay open as long as the instance (they belong to the registry).
class ZEPAppSketcherSettings : public ZEP2DBaseSketcherSettingsAdapt {
public:
  // Through iFile the repositories save to the user's file; without it they are the registry's
  // (opened when needed) and save wherever they were bound before.
  explicit ZEPAppSketcherSettings(ZEPAppSettingsFile* iFile = nullptr);
  ~ZEPAppSketcherSettings() override;

  // Packed 0xRRGGBB. The four diagnoses with a setting answer the adapter's defaults of their
  // setting, so that the colour does not depend on whether it is stored; any other kind is
  // drawn in the plain geometry colour.
  unsigned int GetDefaultColorDiagElts(ZEP2DCstDiag iDiag) override;

  // Sends the event of a page's write when the setting is one the adapter reads; returns
  // whether it did. Called by the write observer.
  bool NotifyPageWrite(const ZEPAppSetting& iSetting);
};

// A readable listing of what the sketcher reads: grid per scale range, creation and
// completion, drag, diagnosis and other colours.
void PrintSketcherSettings(ZEPSketcherSettings& iSettings, std::ostream& oOut);
// The same, read through a hosting object over the application's repositories.
void PrintSketcherSettings(std::ostream& oOut, ZEPAppSettingsFile* iFile = nullptr);

} // namespace zepapp
