#include "host/commands/UpAxisAsking.h"

#include "host/app/Application.h"
#include "host/document/ModelPicture.h"
#include "host/front_end/FrontEnd.h"
#include "import/ModelTurn.h"

#include <new>
#include <optional>
#include <utility>

namespace quarn {

namespace {

UpAxis axisOf(ModelUp up) {
    return up == ModelUp::y ? UpAxis::y : UpAxis::z;
}

/// A model that can stand with either axis up.
class TurnableModel {
public:
    explicit TurnableModel(ImportedModel& model) : m_model(model) {}

    ShownPicture draw(ModelUp up, int width_px, int height_px) {
        try {
            if (!m_scene)
                m_scene = std::make_unique<DocumentScene>();
            if (drawModel(standing(axisOf(up)), *m_scene, width_px, height_px, m_picture))
                return {m_picture.width, m_picture.height, m_picture.rgba};
        } catch (const std::bad_alloc&) {
            m_scene.reset(); // nothing that was half built is used
        }
        return {};
    }

    void settle(UpAxis up) {
        if (up != m_model.up.axis)
            m_model = ImportedModel(standing(up));
        m_model.up = {up, TakenUpAxis::Reason::asked, {}};
    }

    std::unique_ptr<DocumentScene> takeScene() { return std::move(m_scene); }

private:
    const ImportedModel& standing(UpAxis up) {
        if (up == m_model.up.axis)
            return m_model;
        if (!m_turned)
            m_turned = turnedUp(m_model, up);
        return *m_turned;
    }

    ImportedModel& m_model;
    std::optional<ImportedModel> m_turned;
    std::unique_ptr<DocumentScene> m_scene; ///< null until something is drawn
    Image m_picture;
};

} // namespace

std::unique_ptr<DocumentScene> askUpAxis(const std::filesystem::path& file, ImportedModel& model) {
    if (model.up.reason != TakenUpAxis::Reason::habit)
        return nullptr;
    TurnableModel turnable(model);
    const auto draw = [&](ModelUp up, int width_px, int height_px) {
        return turnable.draw(up, width_px, height_px);
    };
    const ModelUp taken = model.up.axis == UpAxis::y ? ModelUp::y : ModelUp::z;
    const auto chosen = Application::current()->frontEnd().chooseUpAxis({file, taken, draw});
    if (chosen)
        turnable.settle(axisOf(*chosen));
    return turnable.takeScene();
}

} // namespace quarn
