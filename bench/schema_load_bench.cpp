// Time to load a schema the way every Validate call does: a fresh handler, the whole
// document parsed into its model, the model destroyed. Prints each run's figure and the
// median.
#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <vector>

#include "fix/kxfixvalidator.h"
#include "schema/loadschema.h"

int main(int argc, char** argv) {
    if (argc < 2 || argc > 3) {
        std::fprintf(stderr, "usage: schema_load_bench SCHEMA [RUNS]\n");
        return 2;
    }
    const int runs = argc == 3 ? std::max(1, std::atoi(argv[2])) : 21;
    const KXFIXValidator validator;  // initialises the XML library, as a host's first call does
    std::vector<double> ms;
    size_t nodes = 0;
    for (int i = 0; i < runs; ++i) {
        const auto start = std::chrono::steady_clock::now();
        {
            FIXKXSchemaSpec handler;
            if (!loadSchema(handler, argv[1])) {
                std::fprintf(stderr, "%s: the schema did not load\n", argv[1]);
                return 1;
            }
            nodes = handler.getFieldMap().size();
        }
        const std::chrono::duration<double, std::milli> took =
            std::chrono::steady_clock::now() - start;
        ms.push_back(took.count());
    }
    std::sort(ms.begin(), ms.end());
    std::printf("%s: %zu map entries, %d runs, min %.2f ms, median %.2f ms\n", argv[1], nodes, runs,
                ms.front(), ms[ms.size() / 2]);
    return 0;
}
