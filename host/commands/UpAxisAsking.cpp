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
    TurnableModel(ImportedModel& model, const DocumentScene* built)
        : m_model(model), m_built(built) {}

    ShownPicture draw(ModelUp up, int width_px, int height_px) {
        try {
            if (!m_scene)
                m_scene = newScene();
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

private:
    std::unique_ptr<DocumentScene> newScene() const {
        auto scene = std::make_unique<DocumentScene>();
        if (m_built)
            scene->shareWith(*m_built);
        return scene;
    }

    const ImportedModel& standing(UpAxis up) {
        if (up == m_model.up.axis)
            return m_model;
        if (!m_turned)
            m_turned = turnedUp(m_model, up);
        return *m_turned;
    }

    ImportedModel& m_model;
    const DocumentScene* m_built;
    std::optional<ImportedModel> m_turned;
    std::unique_ptr<DocumentScene> m_scene; ///< null until something is drawn
    Image m_picture;
};

} // namespace

void askUpAxis(const std::filesystem::path& file, ImportedModel& model,
               const DocumentScene* built) {
    if (model.up.reason != TakenUpAxis::Reason::habit)
        return;
    TurnableModel turnable(model, built);
    const auto draw = [&](ModelUp up, int width_px, int height_px) {
        return turnable.draw(up, width_px, height_px);
    };
    const ModelUp taken = model.up.axis == UpAxis::y ? ModelUp::y : ModelUp::z;
    const auto chosen = Application::current()->frontEnd().chooseUpAxis({file, taken, draw});
    if (chosen)
        turnable.settle(axisOf(*chosen));
}

} // namespace quarn
