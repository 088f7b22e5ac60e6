#pragma once

#include "host/front_end/DialogTemplate.h"
#include "host/front_end/DialogWindow.h"
#include "host/front_end/FrontEndChoices.h"
#include "host/front_end/RecordingReport.h"
#include "host/front_end/SharedFileReport.h"
#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnExport.h"
#include "sdk/qncore/QnWnd.h"

#include <filesystem>
#include <memory>
#include <optional>
#include <string_view>
#include <vector>

class CQuarnView;

namespace quarn {

/// An option that a question offers.
struct QuestionOption {
    KM_wString english_name;
    KM_wString local_name;
    KM_wString value; ///< shown as `Name=Value`; empty for a plain option
};

/// A question that a command asks a person.
struct Question {
    enum class Kind { option, string, integer, number, object };
    Kind kind = Kind::option;
    KM_wString prompt;                   ///< without a colon
    std::vector<QuestionOption> options; ///< in the order they were added
    std::optional<KM_wString> default_answer;
    bool accepts_nothing = false;         ///< Enter without an answer ends the question
    std::vector<KM_wString> object_names; ///< that answer a question for objects; else empty
    bool takes_points = false;            ///< text is a point, written x,y,z
};

/// What a person answered: a word, Enter, Escape, or nothing because nobody can be asked.
struct Answer {
    enum class Kind { text, enter, cancel, nobody };
    Kind kind = Kind::nobody;
    KM_wString text;
};

/// The steps in which a model file becomes something to see, one after the other.
enum class ModelStep {
    read,  ///< the file is understood
    made,  ///< its meshes are made
    built, ///< what rays search is built, so that they can be drawn
};

/// The port through which everything is asked of, and told to, a person. The host calls it on the
/// main thread only. Implementations throw nothing.
class QNCORE_API FrontEnd {
public:
    virtual ~FrontEnd();

    /// Shows text on the command line; line breaks are part of the text.
    virtual void print(std::wstring_view text) = 0;
    /// Tells a person what they should know although the work goes on; seen also where what is
    /// printed is not. Prints it as a line unless it is overridden.
    /// @param text  a sentence, without a line break
    virtual void warn(std::wstring_view text);
    /// Asks a question and waits for one answer. The host checks the answer and asks again.
    virtual Answer ask(const Question& question) = 0;
    /// Shows a message and waits until it is confirmed. @return 1
    virtual int showMessage(std::wstring_view text, std::wstring_view title, unsigned flags) = 0;
    /// Lets a person choose a folder. @return nothing when none was chosen
    virtual std::optional<std::filesystem::path>
    chooseFolder(std::wstring_view title, std::wstring_view message,
                 const std::filesystem::path& start_folder) = 0;
    /// Works on its events for that long.
    virtual void pumpEvents(unsigned milliseconds) = 0;
    /// Whether a key is down now.
    virtual bool isKeyDown(int virtual_key) = 0;
    /// Whether the person asked the program to stop. While true the host draws nothing more.
    virtual bool isInterrupted() const = 0;
    /// The main window; null where there is none.
    virtual HWND mainWindow() = 0;
    /// Told when a recording has begun in its folder. Shows nothing unless it is overridden.
    virtual void recordingBegun(const RecordingStart& start);
    /// Told after a picture of an animation was written.
    /// @param written  pictures of this recording so far, from 1
    /// @param total    frames that this recording makes; 0 when that is not known
    virtual void frameWritten(const std::filesystem::path& file, int written, int total) = 0;
    /// Told once the command that records an animation has ended, also where it recorded nothing in
    /// a folder that it had. Shows nothing unless it is overridden.
    virtual void recordingEnded(const RecordingReport& report);
    /// Told again and again while a file for others is made of frames, and the program would do
    /// nothing else. Shows nothing unless it is overridden.
    /// @param share  how much of it is done, from 0 to 1
    virtual void sharedFileProgress(const std::filesystem::path& file, double share);
    /// Told once such a file is there, or could not be made. Prints its text as a line unless it is
    /// overridden.
    virtual void sharedFileEnded(const SharedFileReport& report);
    /// Told some times a second while a picture is rendered. Shows nothing unless it is overridden.
    /// @param share  how much of the picture is done, from 0 to 1; 1 comes last, however it ended
    virtual void pictureRendered(double share);
    /// Told some times a second while a model or document file is loaded that takes longer than a
    /// moment, and once when that has ended. Shows nothing unless it is overridden.
    /// @param share  how much of the step is done, from 0 to 1; that of the step `built` is 1 once
    ///               and last, however it ended
    virtual void modelRead(const std::filesystem::path& file, ModelStep step, double share);

    // ---- Windows. A front end without any leaves these as they are: it shows nothing, and nobody
    // chooses.

    /// Makes the window of a dialog; it is shown when it runs.
    /// @param owner  the window it stands before; null for the main window
    /// @return null where there are no dialogs
    virtual std::unique_ptr<DialogWindow> makeDialog(const DialogTemplate& form, HWND owner);
    /// Lets a person choose a place on the earth. @return nothing when none was chosen
    virtual std::optional<Place> chooseLocation(std::wstring_view title, const Place& start);
    /// Lets a person choose a file to open, or one to save in; an existing one of the latter only
    /// after the person agreed to replace it.
    virtual FileChoice chooseFile(const FileQuestion& question);
    /// Lets a person choose which axis of a model file points up. @return nothing when none was
    virtual std::optional<ModelUp> chooseUpAxis(const UpAxisQuestion& question);
    /// Told whenever a view shows a picture, drawn anew or not.
    virtual void viewShown(CQuarnView& view, const ShownPicture& picture);
    /// Told when the render window shows another picture; one of no size when it was closed. Where
    /// there is a main window, also now and then while a picture is rendered, how far it is; at the
    /// end then with the picture that the window keeps, the earlier one after a cancelled render.
    virtual void renderWindowShown(const ShownPicture& picture);
};

} // namespace quarn
