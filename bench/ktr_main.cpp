#include "bench/KtrScene.h"

int main(int argc, char** argv) {
    ktr::bench::KtrScene scene;
    return ktr::bench::runBenchProgram(argc, argv, scene);
}
