// The command line of drafting-options: the pages of the drafting options dialog on the
// settings files, shown, changed through their controls as a user would, locked and rendered.
#pragma once

#include "ZEPAppControls.h"

#include <ostream>

namespace zepapp {

// Runs one command line (argv[0] is the program) and answers its exit code (ZEPAppExit).
// Starts from the files every time: the host's repositories are closed on entry and on exit.
int RunCli(int argc, const char* const* argv, std::ostream& out, std::ostream& err);

} // namespace zepapp
