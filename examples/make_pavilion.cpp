// Writes the example model: a small pavilion on a town square, as pavilion.obj and pavilion.mtl.
// Metres, z up, about 32 m across. The curve "Walk" is a way for a camera at eye height.

#include "examples/pavilion/Pavilion.h"

#include <filesystem>
#include <iostream>

int main(int argc, char** argv) {
    const std::filesystem::path folder = argc > 1 ? argv[1] : ".";
    if (!pavilion::write(folder)) {
        std::cerr << "make_pavilion: cannot write into '" << folder.string()
                  << "'. Usage: make_pavilion [FOLDER]\n";
        return 1;
    }
    std::cout << (folder / "pavilion.obj").string() << '\n';
}
