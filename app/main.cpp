// drafting-options: without arguments, an overview of every page on the user's settings.
#include "ZEPAppCli.h"

#include <iostream>

int main(int argc, char** argv) { return zepapp::RunCli(argc, argv, std::cout, std::cerr); }
