#include "tests/plug-ins/TestPlugIn.h"

#include <fstream>

// Stands in for a renderer: every command writes itself into the journal, and saving writes a file
// with the name of the last renderer in it.

namespace {

std::string the_render_window;

class RenderCommand final : public CQuarnCommand {
public:
    RenderCommand(const wchar_t* name, const char* id) : m_name(name), m_id(id) {}
    KM_UUID CommandUUID() override { return KM_UuidFromString(m_id); }
    const wchar_t* EnglishCommandName() override { return m_name; }
    result RunCommand(const CQuarnCommandContext&) override {
        the_render_window = KM_wString(m_name).ToUtf8();
        AddToJournal(the_render_window);
        return success;
    }

private:
    const wchar_t* m_name;
    const char* m_id;
};

class SaveCommand final : public CQuarnCommand {
public:
    KM_UUID CommandUUID() override {
        return KM_UuidFromString("6E1D9C52-0F37-4F0B-93B8-2A61C7D4E803");
    }
    const wchar_t* EnglishCommandName() override { return L"SaveRenderWindowAs"; }
    result RunCommand(const CQuarnCommandContext&) override {
        CQuarnGetString prompt;
        prompt.SetCommandPrompt(L"File");
        prompt.GetString();
        if (prompt.CommandResult() != success)
            return prompt.CommandResult();
        AddToJournal("SaveRenderWindowAs");
        std::ofstream(KM_wString(prompt.String()).ToUtf8()) << the_render_window;
        return success;
    }
};

TestApplication the_application;
TestPlugIn the_plug_in("6E1D9C52-0F37-4F0B-93B8-2A61C7D4E800");
RenderCommand the_render(L"Render", "6E1D9C52-0F37-4F0B-93B8-2A61C7D4E801");
RenderCommand the_preview(L"RenderPreview", "6E1D9C52-0F37-4F0B-93B8-2A61C7D4E802");
SaveCommand the_save;
TestCommand the_close(L"CloseRenderWindow", "6E1D9C52-0F37-4F0B-93B8-2A61C7D4E804");

} // namespace

TEST_PLUGIN_EXPORTS
