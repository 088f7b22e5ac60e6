#pragma once

#include "sdk/qncore/QnCommand.h"
#include "sdk/qncore/QnPlugIn.h"
#include "sdk/qncore/QnWinApp.h"

#include <vector>

namespace quarn {

/// Objects whose constructors announced them and that nobody has checked yet. The constructors of
/// a plug-in file's global objects run inside `dlopen`, before its version can be read, so they may
/// not do more than this.
///
/// There is one list for the objects of the program itself; while a Scope lives, new objects go to
/// the Scope's list instead.
class PendingObjects {
public:
    std::vector<CWinApp*> applications;
    std::vector<CQuarnPlugIn*> plug_ins;
    std::vector<CQuarnCommand*> commands;

    class Scope;

    /// The objects that were announced outside every scope: those of the program.
    static PendingObjects& program();
    /// Adds an object to the list of now.
    static void announce(CWinApp& application);
    static void announce(CQuarnPlugIn& plug_in);
    static void announce(CQuarnCommand& command);
    /// Takes an object that is being destroyed out of every list.
    static void forget(CWinApp& application);
    static void forget(CQuarnPlugIn& plug_in);
    static void forget(CQuarnCommand& command);
};

/// Collects what is announced while it lives. Scopes nest like blocks.
class PendingObjects::Scope {
public:
    Scope();
    ~Scope();
    Scope(const Scope&) = delete;
    Scope& operator=(const Scope&) = delete;

    const PendingObjects& objects() const { return m_objects; }

private:
    PendingObjects m_objects;
};

} // namespace quarn
