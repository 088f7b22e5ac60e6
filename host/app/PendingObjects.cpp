#include "host/app/PendingObjects.h"

#include <algorithm>

namespace quarn {

namespace {

/// The program's list first, then one for each living scope. Global objects announce themselves
/// before main, so the lists are made at the first use.
std::vector<PendingObjects*>& lists() {
    static PendingObjects program_objects;
    static std::vector<PendingObjects*> all = {&program_objects};
    return all;
}

template <class Object>
void erase(std::vector<Object*> PendingObjects::*member, const Object& object) {
    for (PendingObjects* list : lists())
        std::erase(list->*member, &object);
}

} // namespace

PendingObjects& PendingObjects::program() {
    return *lists().front();
}

void PendingObjects::announce(CWinApp& application) {
    lists().back()->applications.push_back(&application);
}

void PendingObjects::announce(CQuarnPlugIn& plug_in) {
    lists().back()->plug_ins.push_back(&plug_in);
}

void PendingObjects::announce(CQuarnCommand& command) {
    lists().back()->commands.push_back(&command);
}

void PendingObjects::forget(CWinApp& application) {
    erase(&PendingObjects::applications, application);
}

void PendingObjects::forget(CQuarnPlugIn& plug_in) {
    erase(&PendingObjects::plug_ins, plug_in);
}

void PendingObjects::forget(CQuarnCommand& command) {
    erase(&PendingObjects::commands, command);
}

PendingObjects::Scope::Scope() {
    lists().push_back(&m_objects);
}

PendingObjects::Scope::~Scope() {
    lists().pop_back();
}

} // namespace quarn
