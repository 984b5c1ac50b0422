// drafting-options: without arguments, an overview of every page on the user's settings.
#include "ZEPAppCli.h"

#include <csignal>
#include <iostream>

int main(int argc, char** argv) {
  // A file size limit (ulimit -f) must make a save fail with a message, not kill the process
  // half way: ignored, the write fails with EFBIG and the save reports it.
  std::signal(SIGXFSZ, SIG_IGN);
  return zepapp::RunCli(argc, argv, std::cout, std::cerr);
}
