// Curve files. Whatever the text, it is refused with a reason or makes a curve that can be followed
// and that has a form of even speed, or none for a reason.
#include "host/curves/CurveFile.h"
#include "host/curves/EvenSpeed.h"

#include <cstdint>
#include <cstdlib>

namespace {

// A broken promise ends the program, which is how a fuzzer learns of it.
void require(bool promise) {
    if (!promise)
        std::abort();
}

void follow(const KM_Curve& curve) {
    double length = 0.0;
    require(curve.IsValid() && curve.GetLength(&length) && length > 0.0);
    require(curve.PointAtStart().IsValid() && curve.PointAtEnd().IsValid());
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    const quarn::CurveResult curve =
        quarn::readCurveText({reinterpret_cast<const char*>(bytes), size});
    if (!curve) {
        require(!curve.message().empty());
        return 0;
    }
    follow(*curve.value());
    const double extent = curve.value()->BoundingBox().Diagonal().Length();
    const quarn::CurveResult even = quarn::evenSpeedCurve(*curve.value(), 1e-3 * extent);
    require(even ? even.value()->IsValid() : !even.message().empty());
    return 0;
}
