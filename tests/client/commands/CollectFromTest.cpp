// collect --from as far as it needs no server; tests/collect has the rest.
#include "client/commands/CollectFromCommand.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

class CollectFromTest : public TClientFixture {};

TEST_F(CollectFromTest, OptionsThatDoNotFitAreRefused)
{
    const std::string help = "; see cimdelta collect --help\n";
    const std::vector<std::pair<std::vector<std::string>, std::string>> rows = {
        {{"--from", "array1"}, "array1: found no address of http or https, expected an address such as https://array1:5989\n"},
        {{"--from", ""}, "--from: must not be empty" + help},
        {{"--namespace", "root/cimv2"}, "--namespace requires --from" + help},
        {{"--from", "https://array1", "--only", "users"}, "--only excludes --from" + help},
        {{"--from", "https://array1", "--namespace", "a", "--all-namespaces"}, "--namespace excludes --all-namespaces" + help},
        {{"--from", "https://array1", "--namespace", "//"}, "\"//\" is no namespace; name one such as root/cimv2\n"},
        {{"--from", "https://array1", "--all-namespaces"},
         "--all-namespaces writes a file for each namespace; name a folder for them with --output\n"},
        {{"--from", "https://array1", "--timeout", "0"}, "--timeout: Value 0 not in range 1 to 1000000" + help},
        {{"--from", "https://array1", "-o", "missing/out.xml"}, ""},
        {{"--from", "https://array1", "--ca", "missing.pem"},
         "missing.pem cannot be read: No such file or directory; correct --ca\n"},
    };
    for (auto [arguments, message] : rows) {
        arguments.insert(arguments.begin(), "collect");
        const std::string complaint = Complaint(arguments);
        if (message.empty()) {
            EXPECT_EQ(0U, complaint.find("cimdelta: ")) << arguments.at(1) << arguments.back();
        } else {
            EXPECT_EQ("cimdelta: " + message, complaint);
        }
    }
}

TEST_F(CollectFromTest, EachNamespaceHasAFileOfItsOwn)
{
    const std::vector<std::pair<std::string, std::string>> rows = {
        {"root/cimv2", "root-cimv2.xml"},
        {"root/PG_InterOp", "root-PG_InterOp.xml"},
        {"a-b", "a%2Db.xml"},
        {"a/b", "a-b.xml"},
        {"..", "%2E..xml"},
        {"a.b", "a.b.xml"},
        {"\xc3\xbc %", "%C3%BC%20%25.xml"},
    };
    for (const auto& [name, file] : rows) {
        EXPECT_EQ(file, FileNameOfNamespace(name));
    }
}

}  // namespace
}  // namespace NORVZEL20
