// The command line of drafting-options: the pages of the drafting options dialog on the
// settings files, shown, changed through their controls as a user would, locked and rendered.
#pragma once

#include "ZEPAppControls.h"
#include "ZEPAppPages.h"
#include "ZEPAppRender.h"
#include "ZEPAppSettingsFile.h"

#include <nlohmann/json.hpp>

#include <ostream>

namespace zepapp {

// Runs one command line (argv[0] is the program) and answers its exit code (ZEPAppExit).
// Starts from the files every time: the host's repositories are closed on entry and on exit.
int RunCli(int argc, const char* const* argv, std::ostream& out, std::ostream& err);

// What the commands and the live dialog (ZEPAppServe.h) do the same way.
// Loads both files into the repositories the pages use, the application's defaults under
// them: the status of ZEPAppSettingsFile::Load.
long LoadSettingsFiles(ZEPAppSettingsFile& ioFile, const ZEPAppSettingsPaths& iPaths);
// The set command's change: operates the control with iValue as a user would (or refuses),
// closes the sub-dialog it is in, and saves under the files' lock when the control changed.
// kExitFile with the reason when the save failed.
// Adding a PLM standard first reads the PLM repository file iPLMRepository for the chooser.
ZEPAppOutcome ChangeSetting(ZEPAppSettingsFile& ioFile, const std::vector<ZEPAppControl>& iControls,
                            const ZEPAppControl& iControl, const std::string& iValue,
                            const std::string& iPLMRepository);
// Reads the PLM repository for the chooser before a control that opens it is operated; false,
// with kExitFile and the reason in oOutcome, when the file cannot be used.
bool PrepareChooser(const ZEPAppControl& iControl, const std::string& iPLMRepository, ZEPAppOutcome& oOutcome);
// One control as the JSON of show, get and list; iSetting: which of the control's settings
// (its first when null).
nlohmann::json ControlJson(const ZEPAppPage& iPage, const std::vector<ZEPAppControl>& iControls,
                           const ZEPAppControl& iControl, const ZEPAppSetting* iSetting = nullptr);
// An opened page as render draws it: its sub-dialogs, the why-not tooltips, the scale range.
ZEPAppRenderPage RenderedPage(const ZEPAppPage& iPage, ZEPDlgFrame* iFrame,
                              const std::vector<ZEPAppControl>& iControls);

} // namespace zepapp
