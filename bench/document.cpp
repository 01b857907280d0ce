// The project document at scale: 10 tracks of 10,000 clips, a tenth of them
// keyframed (DocumentGenerator), indented and compact.
//
// Load: RemixParser::parse from the text in memory against a bare jsoncpp
// parse of the same text into a tree. Write: projectToJSONString of the
// loaded project against Json::StreamWriter writing the parsed tree of the
// same document. Both alternate baseline and library in short batches inside
// one benchmark (Interleaved::compare); quote "ratio_to_baseline".
//
// Peak memory: each load runs in a child process of its own (this program
// run again), so that the high-water marks of the bare parse and of the
// library's load are not mixed; the child reads the document from a file,
// exactly sized, and reports its peak resident size, its resident size
// before the parse, and the heap the loaded project keeps.
#include "DocumentGenerator.h"
#include "Interleaved.h"

#include <VelaMediaLib/document/ProjectDocument.h>
#include <VelaMediaLib/document/RemixParser.h>
#include <VelaMediaLib/model/project/Project.h>

#include <benchmark/benchmark.h>
#include <json/reader.h>
#include <json/writer.h>

#include <cstdio>
#include <cstring>
#include <fstream>
#include <iterator>
#include <malloc.h>
#include <map>
#include <memory>
#include <sstream>
#include <stdexcept>
#include <string>
#include <unistd.h>

using namespace VelaMediaLib;

namespace {

const char* const kChildFlag = "--document-peak-child";

const std::string& documentText(bool compact) {
    static std::map<bool, std::string> texts;
    std::string& text = texts[compact];
    if (text.empty()) {
        VelaBench::DocumentShape shape;
        shape.compact = compact;
        text = VelaBench::DocumentGenerator(shape).text();
    }
    return text;
}

long long clipCount() { return VelaBench::DocumentGenerator(VelaBench::DocumentShape()).clipCount(); }

/// Lets a parser read the text without a copy of it.
class TextBuffer : public std::streambuf {
public:
    explicit TextBuffer(const std::string& text) {
        char* begin = const_cast<char*>(text.data()); // the get area is only read
        setg(begin, begin, begin + text.size());
    }
};

// With the settings the library parses with (comments off, duplicate keys
// refused, nothing after the document, the same depth limit): the same work.
Json::Value bareParse(const std::string& text) {
    Json::CharReaderBuilder builder;
    builder["collectComments"] = false;
    builder["allowComments"] = false;
    builder["failIfExtra"] = true;
    builder["rejectDupKeys"] = true;
    builder["allowSpecialFloats"] = false;
    builder["stackLimit"] = 400;
    const std::unique_ptr<Json::CharReader> reader(builder.newCharReader());
    Json::Value root;
    std::string errors;
    if (!reader->parse(text.data(), text.data() + text.size(), &root, &errors))
        throw std::runtime_error(errors);
    return root;
}

ProjectPtr libraryLoad(const std::string& text) {
    TextBuffer buffer(text);
    std::istream in(&buffer);
    RemixParser parser;
    parser.parse(in);
    return parser.project();
}

std::string bareWrite(const Json::Value& root, bool compact) {
    Json::StreamWriterBuilder builder;
    builder["indentation"] = compact ? "" : "  ";
    const std::unique_ptr<Json::StreamWriter> writer(builder.newStreamWriter());
    std::ostringstream out;
    writer->write(root, &out);
    return out.str();
}

void setSizeCounters(benchmark::State& state, const std::string& text) {
    state.counters["document_MB"] = double(text.size()) / 1e6;
    state.counters["clips"] = double(clipCount());
}

void BM_Load_VsBareParse(benchmark::State& state) {
    const bool compact = state.range(0) != 0;
    const std::string& text = documentText(compact);
    Interleaved::compare(
        state, 1, [&](size_t, size_t) { benchmark::DoNotOptimize(bareParse(text)); },
        [&](size_t, size_t) { benchmark::DoNotOptimize(libraryLoad(text)); });
    setSizeCounters(state, text);
}

void BM_Write_VsStreamWriter(benchmark::State& state) {
    const bool compact = state.range(0) != 0;
    const std::string& text = documentText(compact);
    const Json::Value tree = bareParse(text);
    const ProjectPtr project = libraryLoad(text);
    size_t written = 0;
    Interleaved::compare(
        state, 1, [&](size_t, size_t) { benchmark::DoNotOptimize(bareWrite(tree, compact)); },
        [&](size_t, size_t) { written = projectToJSONString(*project, compact).size(); });
    setSizeCounters(state, text);
    state.counters["written_MB"] = double(written) / 1e6;
}

// ---- Peak memory, measured in child processes ----

/// A line of /proc/self/status in kB ("VmHWM", "VmRSS").
long long statusKilobytes(const char* field) {
    std::ifstream status("/proc/self/status");
    std::string line;
    const std::string prefix = std::string(field) + ":";
    while (std::getline(status, line))
        if (line.compare(0, prefix.size(), prefix) == 0) return std::stoll(line.substr(prefix.size()));
    return -1;
}

long long heapInUse() { return (long long)mallinfo2().uordblks; }

/// The child: reads the document, parses it (bare, or the library's load)
/// and prints "peakKB rssBeforeKB keptHeapBytes".
int runChild(const std::string& mode, const std::string& path) {
    std::ifstream file(path, std::ios::binary | std::ios::ate);
    std::string text(size_t(file.tellg()), '\0');
    file.seekg(0);
    file.read(&text[0], std::streamsize(text.size()));
    const long long rssBefore = statusKilobytes("VmRSS");
    const long long heapBefore = heapInUse();
    long long kept = 0;
    if (mode == "bare") {
        Json::Value root = bareParse(text);
        kept = heapInUse() - heapBefore;
    } else {
        const ProjectPtr project = libraryLoad(text);
        kept = heapInUse() - heapBefore; // the tree is gone, the project stays
    }
    std::printf("%lld %lld %lld\n", statusKilobytes("VmHWM"), rssBefore, kept);
    return 0;
}

struct ChildFigures {
    double peakMB = 0, parseMB = 0, keptBytes = 0;
};

ChildFigures measureInChild(const char* mode, const std::string& path) {
    char self[4096] = {};
    const ssize_t length = readlink("/proc/self/exe", self, sizeof self - 1);
    if (length <= 0) throw std::runtime_error("cannot find this program");
    const std::string command = std::string(self) + " " + kChildFlag + " " + mode + " " + path;
    FILE* child = popen(command.c_str(), "r");
    if (!child) throw std::runtime_error("cannot run " + command);
    long long peak = 0, before = 0, kept = 0;
    const int read = std::fscanf(child, "%lld %lld %lld", &peak, &before, &kept);
    if (pclose(child) != 0 || read != 3) throw std::runtime_error("the child failed: " + command);
    return ChildFigures{double(peak) / 1024.0, double(peak - before) / 1024.0, double(kept)};
}

std::string writeTemporary(const std::string& text) {
    char path[] = "/tmp/vela-bench-document-XXXXXX";
    const int fd = mkstemp(path);
    if (fd < 0) throw std::runtime_error("cannot make a temporary file");
    close(fd);
    std::ofstream(path, std::ios::binary) << text;
    return path;
}

void BM_PeakMemory_LoadVsBareParse(benchmark::State& state) {
    const bool compact = state.range(0) != 0;
    const std::string& text = documentText(compact);
    const std::string path = writeTemporary(text);
    ChildFigures bare, load;
    for (auto _ : state) {
        bare = measureInChild("bare", path);
        load = measureInChild("load", path);
    }
    std::remove(path.c_str());
    state.counters["bare_peak_MB"] = bare.peakMB;
    state.counters["load_peak_MB"] = load.peakMB;
    state.counters["peak_ratio"] = load.peakMB / bare.peakMB;
    state.counters["bare_parse_MB"] = bare.parseMB; // the peak above the text itself
    state.counters["load_parse_MB"] = load.parseMB;
    state.counters["tree_bytes_per_clip"] = bare.keptBytes / double(clipCount());
    state.counters["project_bytes_per_clip"] = load.keptBytes / double(clipCount());
    setSizeCounters(state, text);
}

} // namespace

BENCHMARK(BM_Load_VsBareParse)
    ->ArgName("compact")
    ->Arg(0)
    ->Arg(1)
    ->Iterations(6)
    ->Unit(benchmark::kMillisecond);
BENCHMARK(BM_Write_VsStreamWriter)
    ->ArgName("compact")
    ->Arg(0)
    ->Arg(1)
    ->Iterations(6)
    ->Unit(benchmark::kMillisecond);
BENCHMARK(BM_PeakMemory_LoadVsBareParse)
    ->ArgName("compact")
    ->Arg(0)
    ->Arg(1)
    ->Iterations(1)
    ->Unit(benchmark::kMillisecond);

int main(int argc, char** argv) {
    if (argc == 4 && std::strcmp(argv[1], kChildFlag) == 0) return runChild(argv[2], argv[3]);
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}
