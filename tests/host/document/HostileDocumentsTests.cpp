#include "engine/display/DisplayMode.h"
#include "host/document/file/DocumentCoding.h"
#include "host/document/file/DocumentContent.h"
#include "tests/engine/display/HostileNumbers.h"
#include "tests/host/document/DocumentFixtures.h"

namespace quarn::test {
namespace {

constexpr unsigned DOCUMENTS = 150;

bool canBeStored(const PlacedMesh& placed) {
    KM_Xform inverse = placed.world_from_mesh;
    return placed.mesh->IsValid() && inverse.Invert();
}

/// A document of whatever numbers it may hold.
void fill(Document& document, HostileNumbers& numbers) {
    const SceneContent scene = numbers.scene();
    for (const SceneMesh& object : scene.meshes)
        if (canBeStored(object.placed))
            document.objects().addMesh(
                L"Mesh", {object.placed.mesh, nullptr, object.placed.world_from_mesh});
    for (const ScenePoint& point : scene.points)
        if (point.location.IsValid())
            document.objects().addPoint(L"Point", point.location);
    for (const KM_Light& light : scene.lights)
        document.lights().add(light);
    for (const auto& view : document.views()) {
        ASSERT_TRUE(view->setFrameSize(16, 12));
        view->setViewport(numbers.camera(), true, true);
    }
    document.sun().beginChange();
    document.sun().setEnabled(true);
    document.sun().setDirectionToSun({numbers.any(), numbers.any(), numbers.any()});
    document.sun().endChange();
}

TEST(HostileDocuments, WhatADocumentMayHoldIsWrittenReadAndDrawn) {
    ScriptedFrontEnd front_end;
    DocumentList list(front_end);
    for (unsigned seed = 0; seed < DOCUMENTS; ++seed) {
        SCOPED_TRACE(seed);
        HostileNumbers numbers(seed);
        Document& document = list.openNew();
        fill(document, numbers);
        const auto bytes = encodeDocument(document.content(false));
        ASSERT_TRUE(bytes) << bytes.message();
        const auto content = decodeDocument(bytes.value());
        ASSERT_TRUE(content) << content.message();
        Document& read = list.openNew();
        read.openContent(content.value());
        EXPECT_EQ(read.objects().objects().size(), document.objects().objects().size());
        for (const auto& view : read.views())
            for (const DisplayModeAttributes& mode : standardDisplayModes()) {
                ASSERT_TRUE(view->setDisplayMode(mode.id));
                view->redraw(0);
                EXPECT_EQ(view->frameBuffer().width, 16);
            }
    }
}

} // namespace
} // namespace quarn::test
