#include "bench/BenchmarkFiles.h"

#include <unistd.h>

#include <cstdlib>
#include <fstream>
#include <sstream>

#include "bench/TInventoryGenerator.h"

namespace NORVZEL20 {
namespace {

// Every comparison reads the type of the operating system first, so an inventory needs an instance of this class.
std::string WithOperatingSystem(const std::string& xml)
{
    static const std::string kEnd = "</DECLGROUP>";
    static const std::string kOperatingSystem =
        "<VALUE.OBJECT><CLASS NAME=\"KALMO_OperatingSystem\"><PROPERTY NAME=\"Name\" TYPE=\"string\">"
        "<QUALIFIER NAME=\"Key\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>"
        "<PROPERTY NAME=\"OSType\" TYPE=\"uint16\"/></CLASS></VALUE.OBJECT>\n"
        "<VALUE.OBJECT><INSTANCE CLASSNAME=\"KALMO_OperatingSystem\"><PROPERTY NAME=\"Name\" TYPE=\"string\"><VALUE>bench</VALUE>"
        "</PROPERTY><PROPERTY NAME=\"OSType\" TYPE=\"uint16\"><VALUE>36</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>\n";
    std::string result = xml;
    return result.insert(result.rfind(kEnd), kOperatingSystem);
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
    static const std::string xml = [] {
        std::ostringstream out;
        TInventoryGenerator(kBenchInstances).WriteFirstState(out);
        return WithOperatingSystem(out.str());
    }();
    return xml;
}

const std::string& SecondState()
{
    static const std::string xml = [] {
        std::ostringstream out;
        TInventoryGenerator(kBenchInstances).WriteSecondState(out);
        return WithOperatingSystem(out.str());
    }();
    return xml;
}

const std::string& RulesFile()
{
    static const TRulesFile file;
    return file.path;
}

}  // namespace NORVZEL20
