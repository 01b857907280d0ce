// The `vela` command-line tool: reads, checks and rewrites project documents.
#include "Tool.h"

#include <iostream>

int main(int argc, char** argv) {
    std::ios::sync_with_stdio(false);
    VelaTool::Console console{std::cin, std::cout, std::cerr};
    const int status = VelaTool::Tool().run(std::vector<std::string>(argv + 1, argv + argc), console);
    std::cout.flush();
    return std::cout ? status : 1;
}
