#include "bench/FloorScene.h"

int main(int argc, char** argv) {
    ktr::bench::FloorScene scene;
    return ktr::bench::runBenchProgram(argc, argv, scene);
}
