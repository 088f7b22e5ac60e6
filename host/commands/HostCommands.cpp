#include "host/commands/HostCommands.h"

#include "host/app/PendingObjects.h"
#include "sdk/qncore/QnLocalize.h"

namespace quarn {

namespace {

/// Every command of the host: one line here, one function anywhere in this folder.
constexpr HostCommandEntry HOST_COMMANDS[] = {
    {L"Exit", "B9C1E0A4-2F1D-4C52-9A0B-6E4C0D5A7F01", L"Ends the program", 41001, runExit},
    {L"Help", "5D0E7A36-8B7C-4F0E-A3C9-1B2D47E6C802", L"Lists the commands, or tells what one does",
     41002, runHelp},
    {L"LoadPlugIn", "E27F5C18-64A9-4D3B-8E15-90BD1C3A5F03", L"Loads a plug-in file", 41003,
     runLoadPlugIn},
    {L"Run", "0A6D3B92-C57E-4E81-B6F4-3D9E21A8C704",
     L"Opens a file with the desktop's program for it", 41004, runRun},
    {L"AddView", "C3A7E5D0-1F86-4B29-93D4-7E0B52A8F631", L"Adds a view and makes it the active one",
     41030, runAddView},
    {L"AnimationName", "49C9FB9B-489E-452E-9969-663FE5244CD8",
     L"Names the animation: its folder, its pictures and its page", 41005, runAnimationName},
    {L"Camera", "FC92A7B6-3943-4470-A202-20F6B9694993", L"Moves the camera of the active view",
     41006, runCamera},
    {L"Circle", "154FA333-917E-4961-8B52-1FFF3A62DF1B", L"Draws a circle", 41044, runCircle},
    {L"CloseRenderWindow", "30A17DBD-DD67-4B3D-A394-BE3117B47643",
     L"Closes the render window and frees its picture", 41060, runCloseRenderWindow},
    {L"Delete", "A00A9CBC-19EA-489E-BD98-9FAB91F329FB", L"Deletes objects", 41018, runDelete},
    {L"DisplayEdges", "6F0C52E8-93B4-4E1D-A7D6-58C1F09B3E24",
     L"Chooses which edges of meshes the active view's display mode draws", 41070, runDisplayEdges},
    {L"DisplayMode", "5C41F5A0-CFFE-4818-98EF-F4CBFB9B9441",
     L"Chooses what the active view is drawn like", 41007, runDisplayMode},
    {L"EvenSpeed", "2B6A98EB-1420-47A0-9B52-7FC66AA3C316",
     L"Lets a curve be run through at even speed", 41047, runEvenSpeed},
    {L"FitView", "AE8AEB93-A771-4109-A32A-EBE18881D730",
     L"Moves the camera to where all that is visible fills the picture", 41008, runFitView},
    {L"Hide", "3E8C1B57-7D24-4A1F-9C60-52F0B8E6D915", L"Hides objects", 41015, runHide},
    {L"Import", "57F30A77-BCAD-4DC2-8253-2A8754F38C14",
     L"Reads a model or another document into the document", 41009, runImport},
    {L"ImportCurve", "7A48BEC8-A695-4487-A64E-0463A94E52AC",
     L"Reads a curve from a text or JSON file", 41048, runImportCurve},
    {L"JoinSunStudy", "613D126D-2EC8-4B90-9C2F-28BB08AB5791",
     L"Puts the parts of a sun study that falls on several dates behind each other", 42940,
     runJoinSunStudy, true},
    {L"JpegQuality", "7D2E64B1-0C93-4F58-A6E7-35B90F1D8C42",
     L"Chooses how finely JPEG pictures are written", 42840, runJpegQuality},
    {L"Line", "A51B85E0-73EB-45AA-A30D-4CEC8157A1C9", L"Draws a straight line", 41040, runLine},
    {L"List", "14B4E821-C616-4A94-AC34-7E077FFC06C6",
     L"Lists the objects, views and lights of the document", 41010, runList},
    {L"MovePoint", "4D9EE995-3B38-4AD1-8BE5-180C6A0B80BC",
     L"Moves a point of a curve, or a point object", 41046, runMovePoint},
    {L"New", "D6FDEF2D-A0DE-4A58-A3B0-015160EBE7B7", L"Opens an empty document", 41011, runNew},
    {L"NextRecording", "5E81B7C4-2A96-4D0F-8C73-D10F6A94E2B8",
     L"Chooses which frames the next recording makes, and whether it goes on with an earlier one",
     42864, runNextRecording, true},
    {L"Open", "9B677D57-1060-43B9-BD8C-42ADFA0DCDE1",
     L"Opens a document, or a model file as a new one", 41012, runOpen},
    {L"Point", "BCCFC956-461C-4AF5-A8F4-E74D33EA08CA", L"Draws a point", 41045, runPoint},
    {L"Polyline", "32A799F8-663C-4EA2-94A7-F139732F4D6B", L"Draws straight segments through points",
     41041, runPolyline},
    {L"Recover", "B47C9E15-0D8A-4F63-9A2E-71D5F3C8064B",
     L"Opens or discards a document that was not saved when a program ended", 42570, runRecover,
     true},
    {L"RemoveView", "6B94D2F8-E3A1-4C07-8B5E-1D7FA0C36E92", L"Closes a view", 41031, runRemoveView},
    {L"Rename", "C3630EF1-F0A7-45D8-A581-3053A25A8A94", L"Gives an object another name", 41019,
     runRename},
    {L"Render", "033E4FD3-5F54-479C-8433-99A05CEED1ED",
     L"Renders the active view into the render window", 41061, runRender},
    {L"RenderPreview", "C30376C0-AC3C-48EE-97D4-44EAFFBCCD2A",
     L"Renders the active view quickly, with few samples", 41062, runRenderPreview},
    {L"RenderSettings", "67A24B3D-6D9F-4397-BA1A-7AB92E4CD145",
     L"Sets the size and the samples of rendered pictures, and the light of all", 41063,
     runRenderSettings},
    {L"Save", "6FED7E02-F427-4E01-83A9-AE68C037E8D2", L"Saves the document to its file", 41020,
     runSave},
    {L"SaveAs", "EC26B75B-E29D-4B6A-8258-36393987884F",
     L"Saves the document to another file, or in an older version", 41021, runSaveAs},
    {L"SaveFrame", "CB79D03F-C961-4980-B24A-7A514FB4DF9C",
     L"Writes one frame of the animation as a picture", 41035, runSaveFrame},
    {L"SaveRenderWindowAs", "7AD58BAB-F5C2-4054-B156-84CA8134A57C",
     L"Writes the picture of the render window to a file", 41064, runSaveRenderWindowAs},
    {L"SaveSelected", "9D073255-BA94-4872-B00B-980AF89CB879",
     L"Saves the selected objects as a document of their own", 41022, runSaveSelected},
    {L"Select", "F527784F-8EFC-4E56-AA4F-DD3552F7A126",
     L"Selects objects for the commands that work on a selection", 41017, runSelect},
    {L"Show", "91F4A7D2-0B63-4E58-8D3A-C7159E20FB16", L"Shows hidden objects", 41016, runShow},
    {L"Spline", "C42A0033-E00C-4408-BED0-A6DACBAD78BD", L"Draws a curve toward control points",
     41042, runSpline},
    {L"SplineThrough", "8EB81CC5-0B1E-4F32-90EB-FBFB0EB430FB",
     L"Draws a smooth curve through points", 41043, runSplineThrough},
    {L"StandardView", "5D6D6290-083C-42A4-BE01-B8AF4BFF8EB8",
     L"Turns the active view to Top, Front, Right, Perspective or a camera of the model", 41013,
     runStandardView},
    {L"Sun", "8F2D6E0B-35C1-4A97-B0D8-E41C7A95F362",
     L"Turns the sun on or off, or sets where it stands", 41050, runSun},
    {L"SunStudyPlace", "74A637EB-A611-423E-BAEF-0332C034EE8A",
     L"Names the place of the sun study, and the clocks that its times are told by", 42944,
     runSunStudyPlace, true},
    {L"ViewportSize", "CA2AFA6F-6197-4144-A9F6-B47A393E4D08",
     L"Sets the size of the active view in pixels", 41014, runViewportSize},
};

class HostCommand final : public CQuarnCommand {
public:
    explicit HostCommand(const HostCommandEntry& entry)
        : CQuarnCommand(false, false, nullptr, entry.is_hidden), m_entry(&entry) {}

    KM_UUID CommandUUID() override { return KM_UuidFromString(m_entry->id); }
    const wchar_t* EnglishCommandName() override { return m_entry->name; }
    const wchar_t* CommandDescription() override {
        return QnLocalizeString(m_entry->description, m_entry->description_id);
    }
    result RunCommand(const CQuarnCommandContext& context) override {
        return m_entry->run(context);
    }

private:
    const HostCommandEntry* m_entry;
};

} // namespace

std::vector<std::unique_ptr<CQuarnCommand>>
makeCommands(std::span<const HostCommandEntry> entries) {
    const PendingObjects::Scope unannounced;
    std::vector<std::unique_ptr<CQuarnCommand>> commands;
    for (const HostCommandEntry& entry : entries)
        commands.push_back(std::make_unique<HostCommand>(entry));
    return commands;
}

std::vector<std::unique_ptr<CQuarnCommand>> makeHostCommands() {
    return makeCommands(HOST_COMMANDS);
}

} // namespace quarn
