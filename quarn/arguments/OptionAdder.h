#pragma once

#include "quarn/words/Words.h"

#include <CLI/CLI.hpp>
#include <functional>
#include <string>
#include <variant>

namespace quarn::program {

/// Why a word is not taken: a sentence that names its option.
struct Refusal {
    std::string message;
};

/// Reads the word of an option.
/// @param option  its name, for the message
template <class Value>
using Reading =
    std::function<std::variant<Value, Refusal>(const std::string& option, const std::string& word)>;

/// Adds what a command takes: each word is read at once, and one that is refused ends the parsing.
class OptionAdder {
public:
    explicit OptionAdder(CLI::App& command) : m_command(command) {}

    /// @param name          "--size", or a word without hyphens for what stands without a name
    /// @param stored        where the value goes; must be there while words are parsed
    /// @param value_name    what help calls the value
    /// @param default_word  is read now, and shown in help; null: `stored` stays as it is
    template <class Value, class Stored>
    CLI::Option* operator()(const std::string& name, Stored& stored, const std::string& value_name,
                            const Reading<Value>& reading, const std::string& description,
                            const char* default_word = nullptr) const {
        const auto read = [&stored, name, reading](const std::string& word) {
            auto result = reading(name, word);
            if (const Refusal* const refusal = std::get_if<Refusal>(&result))
                throw CLI::ValidationError(refusal->message);
            stored = std::get<Value>(std::move(result));
        };
        CLI::Option* const option =
            m_command.add_option_function<std::string>(name, read, description);
        option->type_name(value_name);
        if (default_word) {
            read(default_word);
            option->default_str(default_word);
        }
        return option;
    }

private:
    CLI::App& m_command;
};

} // namespace quarn::program
