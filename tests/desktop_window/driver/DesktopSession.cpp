#include "tests/desktop_window/driver/DesktopSession.h"

#include <X11/ICE/ICElib.h>
#include <X11/ICE/ICEutil.h>
#include <X11/SM/SMlib.h>

#include <atomic>
#include <cstdlib>
#include <poll.h>
#include <stdexcept>
#include <thread>
#include <vector>

/// Of the library, which declares it nowhere: the session is for programs of this machine.
extern "C" void _IceTransNoListen(const char* protocol);

namespace quarn::test {

namespace {

enum class Order { none, prepare_and_ask, prepare_silently, end };

Bool allowAnyone(char*) {
    return True;
}

} // namespace

/// Everything but the orders and the answer belongs to the thread that listens.
struct DesktopSession::State {
    State();
    ~State();

    void listen(const std::stop_token& stop);
    void follow(Order order);

    std::string address;
    std::atomic<Order> order = Order::none;
    std::atomic<Answer> answer = Answer::none;
    IceListenObj* listeners = nullptr;
    int listener_count = 0;
    IceConn connection = nullptr;
    SmsConn client = nullptr;
    bool is_ending = false;
    std::jthread thread;
};

/// What the library calls when the program says something.
struct DesktopSession::Callbacks {
    static State& stateOf(SmPointer pointer) { return *static_cast<State*>(pointer); }
    static Status registerClient(SmsConn client, SmPointer, char* former_id) {
        std::free(former_id);
        char* const id = SmsGenerateClientID(client);
        SmsRegisterClientReply(client, id);
        std::free(id);
        SmsSaveYourself(client, SmSaveLocal, False, SmInteractStyleNone, False);
        return True;
    }
    static void interactRequest(SmsConn client, SmPointer, int) { SmsInteract(client); }
    static void interactDone(SmsConn client, SmPointer state, Bool is_cancelled) {
        if (!is_cancelled)
            return;
        SmsShutdownCancelled(client);
        stateOf(state).answer = Answer::cancelled;
    }
    static void saveRequest(SmsConn, SmPointer, int, Bool, int, Bool, Bool) {}
    static void phase2Request(SmsConn client, SmPointer) { SmsSaveYourselfPhase2(client); }
    static void saveDone(SmsConn client, SmPointer pointer, Bool) {
        State& state = stateOf(pointer);
        SmsSaveComplete(client);
        if (state.is_ending && state.answer == Answer::none)
            state.answer = Answer::agreed;
    }
    static void close(SmsConn client, SmPointer pointer, int count, char** reasons) {
        State& state = stateOf(pointer);
        SmFreeReasons(count, reasons);
        SmsCleanUp(client);
        IceCloseConnection(state.connection);
        state.client = nullptr;
        state.connection = nullptr;
    }
    static void setProperties(SmsConn, SmPointer, int count, SmProp** properties) {
        for (int i = 0; i < count; ++i)
            SmFreeProperty(properties[i]);
        std::free(properties);
    }
    static void deleteProperties(SmsConn, SmPointer, int count, char** names) {
        for (int i = 0; i < count; ++i)
            std::free(names[i]);
        std::free(names);
    }
    static void getProperties(SmsConn client, SmPointer) {
        SmsReturnProperties(client, 0, nullptr);
    }
    static Status newClient(SmsConn client, SmPointer state, unsigned long* mask,
                            SmsCallbacks* callbacks, char**) {
        stateOf(state).client = client;
        *mask = (1UL << 10) - 1; // all of them
        *callbacks = {{registerClient, state}, {interactRequest, state}, {interactDone, state},
                      {saveRequest, state},    {phase2Request, state},   {saveDone, state},
                      {close, state},          {setProperties, state},   {deleteProperties, state},
                      {getProperties, state}};
        return True;
    }
};

DesktopSession::State::State() {
    _IceTransNoListen("tcp");
    char trouble[256] = "";
    if (!SmsInitialize("Quarn", "1", Callbacks::newClient, this, allowAnyone, sizeof trouble,
                       trouble) ||
        !IceListenForConnections(&listener_count, &listeners, sizeof trouble, trouble))
        throw std::runtime_error(std::string("no desktop session: ") + trouble);
    for (int i = 0; i < listener_count; ++i)
        IceSetHostBasedAuthProc(listeners[i], allowAnyone);
    char* const addresses = IceComposeNetworkIdList(listener_count, listeners);
    address = addresses;
    std::free(addresses);
    thread = std::jthread([this](const std::stop_token& stop) { listen(stop); });
}

DesktopSession::State::~State() {
    thread.request_stop();
    thread.join();
    if (connection)
        IceCloseConnection(connection);
    IceFreeListenObjs(listener_count, listeners);
}

void DesktopSession::State::listen(const std::stop_token& stop) {
    constexpr int BETWEEN_LOOKS_MS = 10;
    while (!stop.stop_requested()) {
        std::vector<pollfd> ready;
        for (int i = 0; i < listener_count; ++i)
            ready.push_back({IceGetListenConnectionNumber(listeners[i]), POLLIN, 0});
        if (connection)
            ready.push_back({IceConnectionNumber(connection), POLLIN, 0});
        poll(ready.data(), ready.size(), BETWEEN_LOOKS_MS);
        if (connection && ready.back().revents != 0)
            IceProcessMessages(connection, nullptr, nullptr);
        for (int i = 0; i < listener_count; ++i)
            if (ready[static_cast<std::size_t>(i)].revents != 0 && !connection) {
                IceAcceptStatus status = IceAcceptSuccess;
                connection = IceAcceptConnection(listeners[i], &status);
            }
        if (client)
            follow(order.exchange(Order::none));
    }
}

void DesktopSession::State::follow(Order given) {
    if (given == Order::end)
        SmsDie(client);
    if (given != Order::prepare_and_ask && given != Order::prepare_silently)
        return;
    is_ending = true;
    SmsSaveYourself(client, SmSaveBoth, True,
                    given == Order::prepare_and_ask ? SmInteractStyleAny : SmInteractStyleNone,
                    False);
}

DesktopSession::DesktopSession() : m_state(std::make_unique<State>()) {}
DesktopSession::~DesktopSession() = default;

const std::string& DesktopSession::address() const {
    return m_state->address;
}

void DesktopSession::prepareEnd(bool may_ask) {
    m_state->answer = Answer::none;
    m_state->order = may_ask ? Order::prepare_and_ask : Order::prepare_silently;
}

DesktopSession::Answer DesktopSession::answer() const {
    return m_state->answer;
}

void DesktopSession::end() {
    m_state->order = Order::end;
}

} // namespace quarn::test
