#pragma once
// Running the vela tool in-process over streams of the test's own, and the
// sample documents it reads.

#include "Tool.h"

#include <fstream>
#include <iterator>
#include <sstream>
#include <string>
#include <vector>

namespace VelaToolTesting {

struct ToolRun {
    int status;
    std::string out, err;
};

inline ToolRun runVela(const std::vector<std::string>& words, const std::string& input = "") {
    std::istringstream in(input);
    std::ostringstream out, err;
    VelaTool::Console console{in, out, err};
    const int status = VelaTool::Tool().run(words, console);
    return ToolRun{status, out.str(), err.str()};
}

inline std::string samplePath(const std::string& name) { return std::string(VELA_SAMPLES_DIR) + "/" + name; }

inline std::string readText(const std::string& path) {
    std::ifstream file(path, std::ios::binary);
    return std::string((std::istreambuf_iterator<char>(file)), std::istreambuf_iterator<char>());
}

inline void writeText(const std::string& path, const std::string& text) {
    std::ofstream file(path, std::ios::binary | std::ios::trunc);
    file << text;
}

} // namespace VelaToolTesting
