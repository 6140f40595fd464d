#include "app/Program.h"

int main(int argc, char** argv) {
    return static_cast<int>(ktr::app::runProgram(argc, argv));
}
