#include "kelmar/KM_BinaryArchive.h"
#include "sdk/qncore/QnDoc.h"
#include "zoetrix/plugin/ZoetrixPlugIn.h"

namespace {

// Programs for older files know no animations.
constexpr int OLDEST_VERSION_WITH_ANIMATIONS = 4;

bool ReadsIntoExistingDocument(const CQuarnFileReadOptions& options) {
    return options.Mode(CQuarnFileReadOptions::insert_mode) ||
           options.Mode(CQuarnFileReadOptions::import_mode);
}

} // namespace

bool CZoetrixPlugIn::CallWriteDocument(const CQuarnFileWriteOptions& options) {
    if (options.SelectedObjectFilter())
        return false;
    if (options.Quarn3dmVersion() < OLDEST_VERSION_WITH_ANIMATIONS)
        return false;
    const CQuarnDoc* doc = CQuarnDoc::FromRuntimeSerialNumber(options.DocumentSerialNumber());
    if (!doc)
        return false;
    const KM_3dmAnimationProperties& record = AnimationProperties(*doc);
    if (record.CaptureType() == KM_3dmAnimationProperties::none)
        return false;
    return record.CameraPoints().Count() > 0 && record.TargetPoints().Count() > 0;
}

bool CZoetrixPlugIn::WriteDocument(CQuarnDoc& doc, KM_BinaryArchive& archive,
                                   const CQuarnFileWriteOptions& options) {
    if (options.SelectedObjectFilter() ||
        options.Quarn3dmVersion() < OLDEST_VERSION_WITH_ANIMATIONS ||
        archive.Archive3dmVersion() < OLDEST_VERSION_WITH_ANIMATIONS)
        return true;
    if (!archive.Write3dmChunkVersion(5, 0))
        return false;
    return AnimationProperties(doc).Write(archive);
}

bool CZoetrixPlugIn::ReadDocument(CQuarnDoc& doc, KM_BinaryArchive& archive,
                                  const CQuarnFileReadOptions& options) {
    KM_3dmAnimationProperties& record = AnimationPropertiesForWrite(doc);
    if (ReadsIntoExistingDocument(options)) {
        record.CameraPoints().SetCount(0);
        record.TargetPoints().SetCount(0);
        record.SetCaptureType(KM_3dmAnimationProperties::none);
        record.SetFrameCount(0);
    }
    return record.Read(archive);
}
