#include "host/app/Application.h"
#include "host/commands/HostCommands.h"
#include "host/commands/ObjectPicking.h"
#include "host/commands/WordsLeft.h"
#include "host/document/Document.h"

namespace quarn {

namespace {

/// Gathers what is to be selected; the document is not touched before the questions are through.
class SelectQuestion {
public:
    explicit SelectQuestion(ObjectTable& objects) : m_objects(objects) {
        for (const auto& object : objects.objects())
            if (object->selected)
                m_wanted.push_back(object->id);
        m_get.SetCommandPrompt(QnLocalizeString(L"Objects to select", 42100));
        m_get.AcceptNothing();
        m_all = m_get.AddCommandOption(QnLocalizeCommandOptionName(L"All", 42100));
        m_none = m_get.AddCommandOption(QnLocalizeCommandOptionName(L"None", 42101));
        m_get.AddCommandOption(QnLocalizeCommandOptionName(L"Last", 42102));
    }

    /// Asks until Enter or the end of the command's line.
    CQuarnCommand::result run() {
        const bool is_line = hasWordsLeft();
        do {
            const CQuarnGet::result answer = m_get.GetObjects(1, 1);
            if (answer == CQuarnGet::nothing)
                break;
            if (answer == CQuarnGet::object)
                m_wanted.push_back(m_get.Object(0).ObjectUuid());
            else if (answer == CQuarnGet::option)
                take(m_get.Option()->m_option_index);
            else
                return m_get.CommandResult();
        } while (!is_line || hasWordsLeft());
        select();
        return CQuarnCommand::success;
    }

private:
    void take(int option) {
        if (option == m_all)
            takeVisible();
        else if (option == m_none)
            m_wanted.clear();
        else if (!m_objects.empty())
            m_wanted.push_back(m_objects.objects().back()->id);
    }

    void takeVisible() {
        for (const auto& object : m_objects.objects())
            if (object->visible)
                m_wanted.push_back(object->id);
    }

    void select() {
        m_objects.selectNone();
        for (const KM_UUID& id : m_wanted)
            m_objects.select(id);
    }

    ObjectTable& m_objects;
    std::vector<KM_UUID> m_wanted;
    CQuarnGetObject m_get;
    int m_all = 0;
    int m_none = 0;
};

} // namespace

CQuarnCommand::result runSelect(const CQuarnCommandContext& context) {
    ObjectTable& objects = Document::of(context.Document()).objects();
    const CQuarnCommand::result result = SelectQuestion(objects).run();
    if (result == CQuarnCommand::success) {
        const auto count = static_cast<std::size_t>(objects.selectedCount());
        Application::current()->tell(objectCountText(count) + " selected.");
    }
    return result;
}

} // namespace quarn
