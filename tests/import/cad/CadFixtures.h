#pragma once

#include "tests/import/ModelFixtures.h"

#include <Quantity_Color.hxx>
#include <TDocStd_Document.hxx>
#include <TopoDS_Shape.hxx>

namespace quarn::test {

/// A document of parts with names and colours, and files of it.
class CadFiles : public testing::Test {
protected:
    CadFiles();

    /// Adds a part that stands by itself.
    TDF_Label addPart(const TopoDS_Shape& shape, const char* name);
    /// Adds an assembly of a plate and of four bolts, each a place of one part.
    void addBoltedPlate();
    void color(const TDF_Label& part, const Quantity_Color& color);

    /// @param unit  of the file's lengths: "MM", "INCH", "M"
    std::filesystem::path writeStep(const char* name, const char* unit = "MM");
    std::filesystem::path writeIges(const char* name);
    std::filesystem::path writeBrep(const char* name, const TopoDS_Shape& shape);

    TemporaryFolder folder;
    Handle(TDocStd_Document) document;
};

/// What STEP writes as these numbers.
Quantity_Color srgb(double r, double g, double b);

} // namespace quarn::test
