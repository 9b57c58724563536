#include "cli/vekcfg.h"

int main(int argc, char** argv)
{
    return cli::RunVekcfg(argc - 1, argv + 1);
}
