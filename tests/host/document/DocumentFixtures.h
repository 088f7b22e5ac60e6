#pragma once

#include "engine/images/Image.h"
#include "host/document/DocumentList.h"
#include "host/front_end/ScriptedFrontEnd.h"
#include "kelmar/KM_PolylineCurve.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"

#include <gtest/gtest.h>

namespace quarn::test {

/// One new document without an application around it.
class DocumentTest : public testing::Test {
protected:
    ScriptedFrontEnd front_end;
    DocumentList list{front_end};
    Document& document = list.openNew();
    ViewState& view = document.activeView();
};

/// A closed box of twelve triangles between two corners.
inline std::shared_ptr<KM_Mesh> boxMesh(const KM_3dPoint& low, const KM_3dPoint& high) {
    auto mesh = std::make_shared<KM_Mesh>();
    for (int corner = 0; corner < 8; ++corner)
        mesh->m_V.push_back(KM_3fPoint(KM_BoundingBox(low, high).Corner(corner)));
    constexpr std::uint32_t QUADS[6][4] = {{0, 2, 3, 1}, {4, 5, 7, 6}, {0, 1, 5, 4},
                                           {2, 6, 7, 3}, {0, 4, 6, 2}, {1, 3, 7, 5}};
    for (const auto& quad : QUADS) {
        mesh->m_F.push_back({{quad[0], quad[1], quad[2]}});
        mesh->m_F.push_back({{quad[0], quad[2], quad[3]}});
    }
    mesh->ComputeVertexNormals();
    return mesh;
}

inline void addBox(Document& document, const KM_3dPoint& low, const KM_3dPoint& high) {
    document.objects().addMesh(L"Box", {boxMesh(low, high)});
}

/// Keeps a record as a plug-in does, and is installed as long as it lives.
class RecordKeeper final : public IQnZoetrixDynamicAccess {
public:
    RecordKeeper() { Zoetrix_SetQuarnDynamicAccess(this); }
    ~RecordKeeper() override { Zoetrix_SetQuarnDynamicAccess(nullptr); }

    const KM_3dmAnimationProperties& AnimationProperties(const CQuarnDoc&) const override {
        return record;
    }
    void SetAnimationProperties(const CQuarnDoc&, const KM_3dmAnimationProperties& rec) override {
        record = rec;
    }
    bool AnimatedViewAtFrame(CQuarnDoc&, const KM_3dmAnimationProperties&, int,
                             KM_Viewport&) override {
        return false;
    }
    bool AnimatedSunAtFrame(CQuarnDoc&, const KM_3dmAnimationProperties&, int, KM_Light&) override {
        return false;
    }

    KM_3dmAnimationProperties record;
};

} // namespace quarn::test
