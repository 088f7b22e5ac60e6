#include "kelmar/KM_AnimationProperties.h"

KM_3dmAnimationProperties::KM_3dmAnimationProperties() = default;

KM_3dmAnimationProperties::KM_3dmAnimationProperties(const KM_3dmAnimationProperties& other) =
    default;

KM_3dmAnimationProperties&
KM_3dmAnimationProperties::operator=(const KM_3dmAnimationProperties& other) = default;

KM_3dmAnimationProperties&
KM_3dmAnimationProperties::operator=(KM_3dmAnimationProperties&& other) noexcept = default;

KM_3dmAnimationProperties::~KM_3dmAnimationProperties() = default;
