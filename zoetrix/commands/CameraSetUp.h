#pragma once

#include "kelmar/KM_AnimationProperties.h"
#include "kelmar/KM_Uuid.h"
#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnObject.h"

class CQuarnDoc;

// What the commands that set up a moving camera have in common.

/// Asks at the command line for the number of frames, at least 1.
/// @param frame_count  offered as the default; receives the answer
/// @return success, or, after a message, the question's own result
int AskFrameCount(int& frame_count);

/// Asks for one object that the camera or its target follows. Objects that are selected are not
/// taken without asking.
///
/// @param prompt   in the user's language
/// @param filter   kinds of CQuarnGetObject::geometry
/// @param last_id  names the object that Enter takes; it may be gone
/// @param path     receives a reference to the object, which may lead nowhere after Enter
/// @return the question's result; nothing is told when it is not success
int AskForPath(const wchar_t* prompt, unsigned int filter, const KM_UUID& last_id,
               CQuarnObjRef& path);

/// What became of the name of an animation.
enum class NameRepair {
    not_needed,
    done,       ///< characters that a file's name cannot have were replaced
    impossible, ///< no file can have the name, and it holds no such character
};

/// Makes the name one that files can have, as far as that is a matter of single characters.
NameRepair RepairName(KM_wString& name);

/// Tells that a curve, or a circle, yields no places for the camera.
/// @return failure
int EndWithoutCameraPoints();

/// Completes a record whose points are set, and stores it in the document: it starts at its first
/// frame.
void StoreAnimation(CQuarnDoc& doc, KM_3dmAnimationProperties& props,
                    KM_3dmAnimationProperties::CaptureTypes type, int frame_count);
