#include "tests/quarn/models/PlacedHouse.h"

#include <fstream>
#include <sstream>

namespace quarn::test {

void writePlacedHouse(const Studio& studio, const std::string& name, double scale,
                      const std::array<double, 3>& offset) {
    std::istringstream original(readFile(studio / "house.obj"));
    std::ofstream placed(studio / name);
    placed.precision(17);
    for (std::string line; std::getline(original, line);) {
        std::istringstream words(line);
        std::string word;
        double x = 0.0;
        double y = 0.0;
        double z = 0.0;
        if (words >> word >> x >> y >> z && word == "v")
            placed << "v " << offset[0] + scale * x << ' ' << offset[1] + scale * y << ' '
                   << offset[2] + scale * z << '\n';
        else
            placed << line << '\n';
    }
}

} // namespace quarn::test
