#pragma once

#include <QKeySequence>

#include <span>

namespace quarn::desktop {

/// The menus of the window, from left to right.
enum class MenuPlace { file, edit, view, draw, display, sun, animation, share, plug_ins, help };

/// A menu's title: English, and its number in the window's string tables.
struct MenuTitle {
    MenuPlace place;
    const wchar_t* title;
    int title_id;
};

/// A command's place in the menus and the words it has there.
struct MenuRow {
    MenuPlace place;
    const wchar_t* command; ///< its English name
    const wchar_t* label;   ///< English, with its mnemonic
    int label_id;           ///< its number in the window's string tables
    /// A shortcut in the portable notation of QKeySequence; null for none.
    const char* shortcut = nullptr;
    bool begins_group = false; ///< a line stands above it
    /// Words that follow the command: it is done at once where it would ask for refinements.
    const wchar_t* words = nullptr;
};

/// Titles in the order of the menu bar.
std::span<const MenuTitle> menuTitles();

/// The commands that have a place, in the order of their menus. Those that are not named here go
/// to the menu of plug-ins, under their own names.
std::span<const MenuRow> menuRows();

} // namespace quarn::desktop
