#include "tests/import/cad/CadFixtures.h"

#include <BRepPrimAPI_MakeBox.hxx>
#include <BRepPrimAPI_MakeCylinder.hxx>
#include <BRepTools.hxx>
#include <IGESCAFControl_Writer.hxx>
#include <Interface_Static.hxx>
#include <Message.hxx>
#include <Message_Messenger.hxx>
#include <STEPCAFControl_Controller.hxx>
#include <STEPCAFControl_Writer.hxx>
#include <TDataStd_Name.hxx>
#include <XCAFApp_Application.hxx>
#include <XCAFDoc_ColorTool.hxx>
#include <XCAFDoc_DocumentTool.hxx>
#include <XCAFDoc_ShapeTool.hxx>

namespace quarn::test {

namespace {

void name(const TDF_Label& label, const char* text) {
    TDataStd_Name::Set(label, text);
}

TopLoc_Location movedTo(double x, double y, double z) {
    gp_Trsf move;
    move.SetTranslation(gp_Vec(x, y, z));
    return TopLoc_Location(move);
}

} // namespace

Quantity_Color srgb(double r, double g, double b) {
    return {r, g, b, Quantity_TOC_sRGB};
}

CadFiles::CadFiles() {
    Message::DefaultMessenger()->ChangePrinters().Clear();
    XCAFApp_Application::GetApplication()->NewDocument("BinXCAF", document);
}

TDF_Label CadFiles::addPart(const TopoDS_Shape& shape, const char* text) {
    const TDF_Label part =
        XCAFDoc_DocumentTool::ShapeTool(document->Main())->AddShape(shape, false);
    name(part, text);
    return part;
}

void CadFiles::color(const TDF_Label& part, const Quantity_Color& color) {
    XCAFDoc_DocumentTool::ColorTool(document->Main())->SetColor(part, color, XCAFDoc_ColorSurf);
}

void CadFiles::addBoltedPlate() {
    const Handle(XCAFDoc_ShapeTool) tool = XCAFDoc_DocumentTool::ShapeTool(document->Main());
    const TDF_Label plate = addPart(BRepPrimAPI_MakeBox(100.0, 60.0, 10.0).Shape(), "Plate");
    const TDF_Label bolt = addPart(BRepPrimAPI_MakeCylinder(4.0, 20.0).Shape(), "Bolt");
    color(plate, srgb(0.8, 0.2, 0.1));
    color(bolt, srgb(0.1, 0.2, 0.8));
    const TDF_Label assembly = tool->NewShape();
    name(assembly, "Bolted plate");
    tool->AddComponent(assembly, plate, TopLoc_Location());
    for (const double x : {10.0, 90.0})
        for (const double y : {10.0, 50.0})
            tool->AddComponent(assembly, bolt, movedTo(x, y, 10.0));
    tool->UpdateAssemblies();
}

std::filesystem::path CadFiles::writeStep(const char* file_name, const char* unit) {
    const std::filesystem::path file = folder / file_name;
    STEPCAFControl_Controller::Init(); // or the writer would forget the unit
    Interface_Static::SetCVal("write.step.unit", unit);
    STEPCAFControl_Writer writer;
    EXPECT_TRUE(writer.Transfer(document));
    EXPECT_EQ(writer.Write(file.c_str()), IFSelect_RetDone);
    return file;
}

std::filesystem::path CadFiles::writeIges(const char* file_name) {
    const std::filesystem::path file = folder / file_name;
    IGESCAFControl_Writer writer;
    EXPECT_TRUE(writer.Transfer(document));
    EXPECT_TRUE(writer.Write(file.c_str()));
    return file;
}

std::filesystem::path CadFiles::writeBrep(const char* file_name, const TopoDS_Shape& shape) {
    const std::filesystem::path file = folder / file_name;
    EXPECT_TRUE(BRepTools::Write(shape, file.c_str()));
    return file;
}

} // namespace quarn::test
