#pragma once

#include <string_view>
#include <thread>

namespace quarn {

// The rules that plug-ins keep when they call the host. A call that breaks one does nothing and
// returns what its header says; the breach is reported by the name of the call and the rule, as in
// "CQuarnView::Redraw: the view was closed".

/// Who is told of a breach. Called on the thread that made it.
using BreachReceiver = void (*)(std::string_view message);

/// Writes the message to the error output; the program goes on.
void logBreach(std::string_view message);
/// Writes the message to the error output and aborts the program.
void abortOnBreach(std::string_view message);

/// abortOnBreach where the environment variable QUARN_STRICT is set to anything but 0, else
/// logBreach.
BreachReceiver breachReceiverOfEnvironment();
/// Replaces the receiver, at first that of the environment. @return the one before
BreachReceiver setBreachReceiver(BreachReceiver receiver);

/// Tells the receiver. May be called on any thread.
/// @param call  the call that broke the rule, as in "CQuarnView::Redraw"
/// @param rule  what was wrong, without a full stop
void reportBreach(std::string_view call, std::string_view rule);

/// Makes the calling thread the one that the interface may be called on.
void claimMainThread();
/// Allows every thread again.
void releaseMainThread();
/// Whether the calling thread is the main thread, or none was claimed.
bool isMainThread();
/// The same for a call of the interface: a breach elsewhere.
bool isOnMainThread(const char* call);
/// Whether a call on a view stands on the main thread and the view is open; a breach otherwise.
/// @param view  whatever knows by isOpen() whether it is; not asked on another thread
template <class View> bool mayCallView(const View& view, const char* call) {
    if (!isOnMainThread(call))
        return false;
    if (!view.isOpen())
        reportBreach(call, "the view was closed");
    return view.isOpen();
}
/// The same for a document, its lights and its sun.
template <class Part> bool mayCallDocument(const Part& part, const char* call) {
    if (!isOnMainThread(call))
        return false;
    if (!part.isOpen())
        reportBreach(call, "the document was closed");
    return part.isOpen();
}

} // namespace quarn
