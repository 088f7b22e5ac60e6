#pragma once

#include "host/document/file/DocumentContent.h"
#include "host/document/file/SharedPlaces.h"

namespace quarn {

// The payloads of the chunks of a document file. Every operation returns false, with the archive
// failed, when the thing cannot be written, or when what is read cannot be part of a document; what
// was to be read is then unspecified.

bool writeSettings(KM_BinaryArchive& archive, const SettingsContent& settings);
bool readSettings(KM_BinaryArchive& archive, SettingsContent& settings);

bool writeTexture(KM_BinaryArchive& archive, const Texture& texture);
/// Adds the texture, material or mesh to what is shared.
bool readTexture(KM_BinaryArchive& archive, SharedContent& shared);

/// @param texture  place of its texture, or NO_PLACE
bool writeMaterial(KM_BinaryArchive& archive, const Material& material, std::int32_t texture);
bool readMaterial(KM_BinaryArchive& archive, SharedContent& shared);

/// About the bytes that a mesh takes.
std::uint64_t meshSize(const KM_Mesh& mesh);
bool writeMesh(KM_BinaryArchive& archive, const KM_Mesh& mesh);
bool readMesh(KM_BinaryArchive& archive, SharedContent& shared);

/// @param mesh      place of its mesh, where it has one
/// @param material  place of its material, or NO_PLACE
bool writeObject(KM_BinaryArchive& archive, const ObjectContent& object, std::int32_t mesh,
                 std::int32_t material);
bool readObject(KM_BinaryArchive& archive, const SharedContent& shared, ObjectContent& object);

bool writeView(KM_BinaryArchive& archive, const ViewContent& view);
bool readView(KM_BinaryArchive& archive, ViewContent& view);

bool writeCamera(KM_BinaryArchive& archive, const CameraContent& camera);
bool readCamera(KM_BinaryArchive& archive, CameraContent& camera);
bool writeEdges(KM_BinaryArchive& archive, const EdgesContent& edges);
bool readEdges(KM_BinaryArchive& archive, EdgesContent& edges);
bool writeRendering(KM_BinaryArchive& archive, const RenderSettings& settings);
bool readRendering(KM_BinaryArchive& archive, RenderSettings& settings);

bool writeLight(KM_BinaryArchive& archive, const LightContent& light);
bool readLight(KM_BinaryArchive& archive, LightContent& light);

bool writePlugIn(KM_BinaryArchive& archive, const PlugInContent& plug_in);
bool readPlugIn(KM_BinaryArchive& archive, PlugInContent& plug_in);

} // namespace quarn
