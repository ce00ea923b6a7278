#include <iostream>

#include "cli/Interruption.h"
#include "cli/Program.h"

int main(int argc, char** argv) {
  Vorn::Cli::EndCleanlyOnSignals();
  return static_cast<int>(Vorn::Cli::RunProgram(argc, argv, std::cin, std::cout, std::cerr));
}
