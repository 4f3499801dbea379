#include "tests/inventories/OracleTable.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <sstream>
#include <stdexcept>
#include <vector>

#include "client/inventory/TInventoryFile.h"

namespace NORVZEL20 {
namespace {

using TJson = nlohmann::json;

std::string ReadAll(const std::string& path)
{
    TInventoryFile file(path);
    std::string text;
    std::vector<char> buffer(1U << 16U);
    while (const std::size_t length = file.Read(buffer.data(), buffer.size())) {
        text.append(buffer.data(), length);
    }
    return text;
}

std::vector<std::string> Split(const std::string& line)
{
    std::vector<std::string> fields;
    std::istringstream stream(line);
    for (std::string field; std::getline(stream, field, '\t');) {
        fields.push_back(field);
    }
    fields.resize(7);
    return fields;
}

std::string Quoted(const std::string& text)
{
    std::string quoted = "\"";
    for (const char character : text) {
        if (character == '"' || character == '\\') {
            quoted += '\\';
        }
        quoted += character;
    }
    return quoted + "\"";
}

std::string PathText(const std::string& cls, const TJson& keys);

// A key is a plain value, a reference, or (inside a reference) a triple of two type names and the value's text.
std::string KeyText(const TJson& key)
{
    if (key.is_array()) {
        return key[0] == "string" ? KeyText(key[2]) : key[2].get<std::string>();
    }
    if (key.is_object()) {
        return Quoted(PathText(key["$ref"].get<std::string>(), key["keys"]));
    }
    if (key.is_boolean()) {
        return key.get<bool>() ? "TRUE" : "FALSE";
    }
    return key.is_string() ? Quoted(key.get<std::string>()) : key.dump();
}

std::string PathText(const std::string& cls, const TJson& keys)
{
    std::vector<std::pair<std::string, std::string>> bindings;
    for (const auto& [name, value] : keys.items()) {
        std::string lower = name;
        std::transform(lower.begin(), lower.end(), lower.begin(), [](unsigned char letter) { return std::tolower(letter); });
        bindings.emplace_back(lower, name + "=" + KeyText(value));
    }
    std::sort(bindings.begin(), bindings.end());
    std::string path = cls;
    for (std::size_t i = 0; i < bindings.size(); ++i) {
        path += (i == 0 ? "." : ",") + bindings[i].second;
    }
    return path;
}

}  // namespace

std::set<std::string> ReadOracle(const std::string& path, const std::set<std::string>& ordered, bool withValues)
{
    std::set<std::string> differences;
    std::istringstream lines(ReadAll(path));
    std::string line;
    std::getline(lines, line);
    if (line.rfind("kind\tclass\tkey", 0) != 0) {
        throw std::runtime_error(path + " is no table of differences");
    }
    while (std::getline(lines, line)) {
        const std::vector<std::string> row = Split(line);
        if (row[6] == "ref-ns" || (row[6] == "bag-equal" && ordered.count(row[3]) == 0)) {
            continue;
        }
        std::string text = row[0] + " " + PathText(row[1], TJson::parse(row[2]));
        if (row[0] == "DIFF") {
            text += " " + row[3];
            if (withValues) {
                text += ": " + TJson::parse(row[4]).dump() + " -> " + TJson::parse(row[5]).dump();
            }
        }
        differences.insert(text);
    }
    return differences;
}

}  // namespace NORVZEL20
