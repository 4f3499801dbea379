// Writes one of the inventories of the benchmarks to standard output.

#include <CLI/CLI.hpp>
#include <iostream>

#include "bench/TInventoryGenerator.h"

int main(int argc, char** argv)
{
    NORVZEL20::TInventoryShape shape;
    unsigned int state = 0;
    CLI::App options("Writes a generated inventory to standard output");
    options.add_option("INSTANCES", shape.instances)->required();
    options.add_option("STATE", state, "0 is the reference; each other number is another state of it")->required();
    options.add_option("--classes", shape.classes, "number of classes")->check(CLI::Range(1, 100000));
    options.add_option("--changed", shape.changedPerMille, "values that change, per mille (default 10)")
        ->check(CLI::Range(0, 1000));
    options.add_option("--shuffled", shape.shuffleSeed, "seed of the order; without it, the order of classes and keys");
    CLI11_PARSE(options, argc, argv);
    if (shape.classes > shape.instances) {
        std::cerr << "generate_inventory: every class needs an instance\n";
        return 2;
    }
    NORVZEL20::TInventoryGenerator(shape).Write(std::cout, state);
    return std::cout.flush().good() ? 0 : 2;
}
