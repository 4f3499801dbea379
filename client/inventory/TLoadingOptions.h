#pragma once

#include <string>
#include <vector>

#include "embedded/load/EBadValues.h"

namespace NORVZEL20 {

/// How the inventories of a command are loaded: the options that all commands share, as they were typed. A plain value.
struct TLoadingOptions {
    /// `[LABEL=]NAME`: the namespace of inventories that name none. One without a label is for all that have no one of their own.
    std::vector<std::string> namespaces;
    /// `SOURCE[,SOURCE...]`: what gives declarations to all inventories.
    std::vector<std::string> schemas;
    /// The files that these stand for, each once; see ListSchemaFiles.
    std::vector<std::string> schemaFiles;
    /// How the command calls the option for `schemas`, for messages.
    std::string schemaOption = "--schema";
    /// The file that the result replaces, which none that is read may be; empty if the result goes to standard output.
    std::string output;
    /// Whether classes that nothing declares are declared as their instances suggest.
    bool infersClasses = false;
    /// What becomes of values that do not fit their types.
    EBadValues badValues = EBadValues::kRefuse;
};

}  // namespace NORVZEL20
