// Makes a demo tree: orbelane-demo-tree ROOT [RESULTS]
#include <cstdio>
#include <cstdlib>
#include <exception>

#include "demo/demo_tree.h"

int main(int argc, char** argv) {
    if (argc < 2) {
        std::fprintf(stderr, "usage: %s ROOT [RESULTS]\n", argv[0]);
        return 2;
    }
    try {
        demo::MakeDemoTree(argv[1], argc > 2 ? std::strtoul(argv[2], nullptr, 10) : 300);
    } catch (const std::exception& e) {
        std::fprintf(stderr, "%s\n", e.what());
        return 1;
    }
    return 0;
}
