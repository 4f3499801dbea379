#include "bench/BenchmarkFiles.h"

#include <unistd.h>

#include <cstdlib>
#include <fstream>
#include <sstream>

#include "bench/TInventoryGenerator.h"

namespace NORVZEL20 {
namespace {

std::string Generate(unsigned int state)
{
    TInventoryShape shape;
    shape.instances = kBenchInstances;
    std::ostringstream out;
    TInventoryGenerator(shape).Write(out, state);
    return out.str();
}

// A temporary file with the rules, removed when the process ends.
struct TRulesFile {
    TRulesFile()
    {
        char name[] = "/tmp/cimdelta-bench-XXXXXX";
        const int descriptor = mkstemp(name);
        if (descriptor < 0) {
            std::abort();
        }
        close(descriptor);
        path = name;
        std::ofstream(path) << "<DifftoolSpec version=\"1.0\"><class name=\"BENCH_Software\" default=\"include\"/></DifftoolSpec>";
    }
    ~TRulesFile() { unlink(path.c_str()); }

    std::string path;
};

}  // namespace

const std::string& FirstState()
{
    static const std::string xml = Generate(0);
    return xml;
}

const std::string& SecondState()
{
    static const std::string xml = Generate(1);
    return xml;
}

const std::string& RulesFile()
{
    static const TRulesFile file;
    return file.path;
}

}  // namespace NORVZEL20
