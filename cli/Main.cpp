#include <iostream>

#include "cli/Program.h"

int main(int argc, char** argv) {
  return static_cast<int>(Vorn::Cli::RunProgram(argc, argv, std::cin, std::cout, std::cerr));
}
