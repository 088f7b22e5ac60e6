#pragma once

#include "kelmar/KM_AnimationProperties.h"
#include "kelmar/KM_Array.h"
#include "kelmar/KM_Uuid.h"
#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnCommand.h"

class CQuarnDoc;
class CQuarnView;

// ---- Options that all set-up commands share

/// Asks at the command line for file type, capture method, viewport and sequence name, in this
/// order, and writes the answers into the record. The answer to the sequence name is not stored:
/// the record keeps the name that it came with. Answers that were given before a prompt failed stay
/// in the record.
///
/// @param sunFilter  offer only the display modes in which a sun study can be seen: shaded ones
///                   that use the document's lights or cast shadows
/// @return success; the prompt's own result when one was cancelled; failure for a viewport that
///         does not exist, a capture method that does not, and a host without display modes
int GetAnimationOptions(CQuarnDoc& doc, KM_3dmAnimationProperties& props, bool sunFilter);

/// Fills the same choices into lists for a dialog. Every list is emptied first; every index is that
/// of the record's present choice (compared exactly), or 0.
///
/// @param captureMethods  the two render methods, then the display modes
/// @param displayModeIds  entry k belongs to entry k+2 of `captureMethods`
/// @param sunFilter       as for GetAnimationOptions
/// @return true
bool GetDailogAnimationOptions(KM_3dmAnimationProperties& props,
                               KM_ClassArray<KM_wString>& fileTypes, int& fileTypeIndex,
                               KM_ClassArray<KM_wString>& captureMethods, int& captureIndex,
                               KM_ClassArray<KM_wString>& viewNames, int& viewIndex,
                               KM_SimpleArray<KM_UUID>& displayModeIds, bool sunFilter);

// ---- Names

/// Appends the names of the active document's views in their order. `names` is not emptied first.
/// @return true
bool GetViewList(KM_ClassArray<KM_wString>& names);

/// Removes every dot.
void CleanExtention(KM_wString& ext);

/// False for an empty name, for a name of 256 or more characters, and for one that holds any of
/// \ | / : * ? " < >.
bool IsValidFileName(KM_wString name);

/// Replaces each of the characters that IsValidFileName refuses by "_".
/// @return how many were replaced
int ReplaceInvalidFileChar(KM_wString& name);

/// Whether a name that came with a document can be put behind a folder's name without leaving that
/// folder: it holds no path separator and no control character.
bool StaysInsideFolder(const KM_wString& name);

/// Whether a path can stand in double quotes in a script: it holds no double quote and no line
/// break, which would let it add words or commands of its own.
bool CanBeQuotedInScript(const KM_wString& path);

// ---- Showing and recording frames

/// Shows frames of the animation in the viewport that the record names. A sun study moves a light
/// of its own and keeps the document's sun off meanwhile; every other animation moves the camera.
/// Curves that the camera or the target follows are hidden meanwhile. A frame without points moves
/// nothing and counts as shown. The record is left with the frame shown last and with the file
/// extension without dots.
///
/// @param frame   from 0: show this frame and leave the view on it; negative: show all and put the
///                view back as it was
/// @param record  write each frame with RecordFrame instead of redrawing the view; the first that
///                is not written ends the showing
/// @return success, also when a frame was not written; failure, after a message, for a record that
///         cannot be played and for a viewport that does not exist (the curves then stay hidden)
int PreviewAnimation(CQuarnDoc& doc, KM_3dmAnimationProperties& props, int frame, bool record);

/// Lets the host work on its events in steps of 10 milliseconds until the time is over, or until
/// the Escape key is found down before a step.
/// @return false, whichever it was
bool WaitAndCheckForEscapeKey(unsigned int milliseconds);

/// Writes the frame that is set up now into the record's folder, which is made when needed, and
/// appends its file name to the record's images: sequence name, frame number with at least three
/// digits, dot, extension. Prints nothing.
///
/// @param docSerialNumber  the document that the render scripts run in
/// @param view             drawn when the record does not ask for a renderer; may be null
/// @return whether the frame was written
bool RecordFrame(unsigned int docSerialNumber, KM_3dmAnimationProperties& props, CQuarnView* view);

/// Writes the page that plays the record's images.
///
/// @param path  white space at its ends is removed
/// @return false, with nothing written, for a blank path and for a file that cannot be written
bool WriteHTML(KM_3dmAnimationProperties& props, const wchar_t* path);

// ---- Commands

/// Shows all frames.
class CCommandPlayAnimation : public CQuarnCommand {
public:
    CCommandPlayAnimation();
    ~CCommandPlayAnimation() override;
    KM_UUID CommandUUID() override;
    const wchar_t* EnglishCommandName() override;
    const wchar_t* CommandDescription() override;
    result RunCommand(const CQuarnCommandContext& context) override;
};

/// Shows the first frame.
class CCommandViewFirstFrame : public CQuarnCommand {
public:
    CCommandViewFirstFrame();
    ~CCommandViewFirstFrame() override;
    KM_UUID CommandUUID() override;
    const wchar_t* EnglishCommandName() override;
    const wchar_t* CommandDescription() override;
    result RunCommand(const CQuarnCommandContext& context) override;
};

/// Shows the last frame.
class CCommandViewLastFrame : public CQuarnCommand {
public:
    CCommandViewLastFrame();
    ~CCommandViewLastFrame() override;
    KM_UUID CommandUUID() override;
    const wchar_t* EnglishCommandName() override;
    const wchar_t* CommandDescription() override;
    result RunCommand(const CQuarnCommandContext& context) override;
};

/// Shows the frame before the one shown last; before the first comes the last.
class CCommandViewPreviousFrame : public CQuarnCommand {
public:
    CCommandViewPreviousFrame();
    ~CCommandViewPreviousFrame() override;
    KM_UUID CommandUUID() override;
    const wchar_t* EnglishCommandName() override;
    const wchar_t* CommandDescription() override;
    result RunCommand(const CQuarnCommandContext& context) override;
};

/// Shows the frame after the one shown last; after the last comes the first.
class CCommandViewNextFrame : public CQuarnCommand {
public:
    CCommandViewNextFrame();
    ~CCommandViewNextFrame() override;
    KM_UUID CommandUUID() override;
    const wchar_t* EnglishCommandName() override;
    const wchar_t* CommandDescription() override;
    result RunCommand(const CQuarnCommandContext& context) override;
};

/// Asks for a frame and shows it.
class CCommandViewFrameNumber : public CQuarnCommand {
public:
    CCommandViewFrameNumber();
    ~CCommandViewFrameNumber() override;
    KM_UUID CommandUUID() override;
    const wchar_t* EnglishCommandName() override;
    const wchar_t* CommandDescription() override;
    result RunCommand(const CQuarnCommandContext& context) override;
};

/// Asks for a folder, writes every frame and a page that plays them, and opens the page if asked.
/// Whether to open it is remembered until the plug-in is unloaded.
class CCommandRecordAnimation : public CQuarnScriptCommand {
public:
    CCommandRecordAnimation();
    ~CCommandRecordAnimation() override;
    KM_UUID CommandUUID() override;
    const wchar_t* EnglishCommandName() override;
    const wchar_t* CommandDescription() override;
    result RunCommand(const CQuarnCommandContext& context) override;
};
