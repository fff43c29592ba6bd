#include "nidus/CommandLine.h"

int main(int argc, char** argv) { return nidus::runCommandLine(argc, argv); }
