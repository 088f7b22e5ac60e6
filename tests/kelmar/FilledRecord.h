#pragma once

#include "kelmar/KM_AnimationProperties.h"

/// A record in which every field has a value of its own, none of them its default.
KM_3dmAnimationProperties filledRecord();

/// Expects that every field holds what filledRecord gives it.
void expectFilled(KM_3dmAnimationProperties& record);
