#pragma once

#include <optional>
#include <string>

namespace quarn::program {

/// The first mistake of what was typed; later ones are often its consequences.
class FirstMistake {
public:
    /// Takes a mistake; nothing is none.
    void note(std::optional<std::string> mistake) {
        if (!m_text)
            m_text = std::move(mistake);
    }

    const std::optional<std::string>& text() const { return m_text; }

private:
    std::optional<std::string> m_text;
};

/// The end of a message about a word that cannot be taken.
inline std::string notBut(const std::string& word) {
    return ", not \"" + word + "\".";
}

} // namespace quarn::program
