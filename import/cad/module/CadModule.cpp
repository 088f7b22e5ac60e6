#include "import/cad/CadModule.h"

#include "import/cad/module/CadDocument.h"
#include "import/cad/module/CadMeshes.h"
#include "import/files/ModelFileCheck.h"

#include <Message.hxx>
#include <Message_Messenger.hxx>
#include <Message_Printer.hxx>
#include <Standard_Failure.hxx>

#include <exception>
#include <new>

namespace quarn {

namespace {

constexpr const char* TRY_AGAIN = "Export the model again or restore the file.";

TakenUpAxis upAxisOf(UpAxis asked) {
    if (asked == UpAxis::by_format)
        return {UpAxis::z, TakenUpAxis::Reason::habit, {}};
    return {asked, TakenUpAxis::Reason::asked, {}};
}

Result<SourceScene> readChecked(const ModelReading& reading, CadFormat format) {
    Message::DefaultMessenger()->ChangePrinters().Clear(); // they write to the person's terminal
    const Result<Handle(TDocStd_Document)> document = readCadDocument(reading, format);
    if (!document)
        return cannotReadModel(reading.path, document.message(), TRY_AGAIN);
    Result<SourceScene> scene = meshesOf(document.value(), reading);
    if (!scene)
        return cannotReadModel(reading.path, scene.message(), "Use a smaller model.");
    scene.value().units = format == CadFormat::brep ? UnitSystem::none : UnitSystem::millimeters;
    scene.value().up = upAxisOf(reading.up);
    if (std::string cut_off = cutOffText(reading, format); !cut_off.empty())
        scene.value().warnings.push_back(std::move(cut_off));
    return scene;
}

} // namespace

} // namespace quarn

extern "C" __attribute__((visibility("default"))) void
quarnReadCad(const quarn::ModelReading& reading, quarn::CadFormat format,
             quarn::Result<quarn::SourceScene>& scene) {
    using quarn::cannotReadModel;
    try {
        scene = quarn::readChecked(reading, format);
    } catch (const Standard_Failure& failure) {
        scene = cannotReadModel(
            reading.path, std::string("it is damaged (") + failure.DynamicType()->Name() + ")",
            quarn::TRY_AGAIN);
    } catch (const std::bad_alloc&) {
        scene = cannotReadModel(reading.path, "there is not enough memory", "Use a smaller model.");
    } catch (const std::exception& failure) {
        scene = cannotReadModel(reading.path, failure.what(), quarn::TRY_AGAIN);
    }
}
