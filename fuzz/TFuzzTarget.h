#pragma once

#include <string_view>
#include <vector>

namespace NORVZEL20 {

/// A function that takes any bytes, runs one part of the system over them and checks what that part promises.
///
/// Throws TBrokenPromise if a promise was broken; any other exception is a finding too. The same bytes give the same outcome.
struct TFuzzTarget {
    const char* name;  ///< also the name of its folders in corpus/ and found/ and of its dictionary
    void (*run)(std::string_view input);

    /// All targets, in the order of their names.
    static const std::vector<TFuzzTarget>& GetAll();
};

void FuzzAnswer(std::string_view input);         ///< an answer of a WBEM server
void FuzzArguments(std::string_view input);      ///< a command line of the client, one argument a line
void FuzzBaseline(std::string_view input);       ///< a file of accepted differences
void FuzzCollect(std::string_view input);        ///< a text or bytes of a system from which an inventory is collected
void FuzzEngine(std::string_view input);         ///< throws of dice, from which namespaces and rules are made
void FuzzHttp(std::string_view input);           ///< recorded answers of HTTP
void FuzzInventory(std::string_view input);      ///< a CIM-XML document
void FuzzMof(std::string_view input);            ///< a MOF document and a file that it may include
void FuzzPath(std::string_view input);           ///< the text of an object path
void FuzzQuery(std::string_view input);          ///< a whole query, or the condition of one
void FuzzSpecification(std::string_view input);  ///< a specification file
void FuzzTokenizer(std::string_view input);      ///< an XML document
void FuzzValue(std::string_view input);          ///< the text of one value

}  // namespace NORVZEL20
