#include <iostream>

#include "cli/Program.h"
#include "cli/terminal/Interruption.h"

int main(int argc, char** argv) {
  Vorn::Cli::EndCleanlyOnSignals();
  return static_cast<int>(Vorn::Cli::RunProgram(argc, argv, std::cin, std::cout, std::cerr));
}
