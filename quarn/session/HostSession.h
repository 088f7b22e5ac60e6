#pragma once

#include "host/session/Session.h"
#include "quarn/session/ConsoleFrontEnd.h"
#include "quarn/words/Outcome.h"

#include <cstdint>
#include <optional>

namespace quarn::program {

/// How a person wants the host to be run.
struct CommonOptions {
    bool is_verbose = false;
    std::string language;          ///< empty: the environment's
    bool overwrites = false;       ///< as SessionOptions has it
    std::uint64_t most_memory = 0; ///< as SessionOptions has it
    int most_threads = 0;          ///< as SessionOptions has it
    std::string instructions;      ///< as SessionOptions has it, and not refused
};

/// The host as this program runs it: with the files that are installed beside the program.
class HostSession {
public:
    /// What is done with the models that it reads.
    enum class Use { pictures, numbers };

    HostSession(ConsoleFrontEnd& front_end, const CommonOptions& common, Use use = Use::pictures);

    /// Loads the plug-in that sets up and records animations.
    /// @return nothing when it is there, else why it is not
    std::optional<Outcome> loadAnimationPlugIn();

    /// Runs one host command, in UTF-8.
    /// @return nothing when it succeeded, else how the program ends
    std::optional<Outcome> run(const std::string& line);

    /// Opens a document file, or reads a model file into the document that is there. Result as of
    /// run().
    std::optional<Outcome> readModel(const std::filesystem::path& model);

    /// Runs the host command that reads a model or a document. What is wrong with the file, but not
    /// so wrong that it cannot be shown, is told even where the host's words are hidden. Result as
    /// of run().
    std::optional<Outcome> runReading(const std::string& line, const std::filesystem::path& model);

    Session& session() { return m_session; }
    ConsoleFrontEnd& frontEnd() { return m_front_end; }

private:
    ConsoleFrontEnd& m_front_end;
    Session m_session;
};

/// Whether the host's words are shown: only to a person who wants to see all of them.
ConsoleFrontEnd::Prints printsFor(const CommonOptions& common);

/// How the program ends when it was asked to stop.
Outcome stopped(const std::string& message);

} // namespace quarn::program
