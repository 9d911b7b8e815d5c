// pyr_load_save_once IN OUT: reads a GéoBase and saves it, once, in a process of its own, as a person
// does who opens a job: every page of the store is new to the process.
#include "geobase/Carnet.h"

int main(int argc, char** argv) {
    if (argc != 3) return 2;
    pyr::CCarnet carnet;
    return carnet.Load(nullptr, argv[1]) && carnet.Save(argv[2]) ? 0 : 1;
}
