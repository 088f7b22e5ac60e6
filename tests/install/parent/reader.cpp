#include "kelmar/kelmar.h"

int main() {
    return KM_3dPoint(0.0, 0.0, 0.0).IsValid() ? 0 : 1;
}
