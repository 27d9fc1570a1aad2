#pragma once

#include <list>
#include <memory>
#include <optional>
#include <random>
#include <string>
#include <string_view>
#include <vector>

#include "platform/system/MainQueue.h"
#include "platform/system/MessagePorts.h"
#include "platform/telephony/Technology.h"

namespace kelvo::soak {

/// What is wrong with the service.
enum class Fault {
    None,     ///< all messages of the capture at once, every half second
    Late,     ///< answers come after the client has given up
    Garbage,  ///< answers are anything but answers
    Records,  ///< between the messages of the capture come mutilated ones, other ids and datagrams of any form
    Flood,    ///< as many and as long messages as the client takes
};
std::optional<Fault> faultNamed(std::string_view name);

/// A telephony service that does everything wrong that one can do. Says on standard output which client streams.
/// Main queue only; `queue` and `ports` outlive it.
class FaultyService {
public:
    FaultyService(MainQueue& queue, MessagePorts& ports, Fault fault, Technology technology,
                  std::vector<Bytes> messages);

    /// Makes the control port; false when it cannot be had.
    bool open();

private:
    struct Client {
        std::string name;
        std::unique_ptr<RemotePort> records;  // to the client
        std::unique_ptr<LocalPort> channel;   // from the client
        bool streams = false;
        std::size_t next = 0;  // message of a flood
    };

    Bytes createChannel(ByteView request);
    Bytes command(Client& client, ByteView message);
    Bytes spoilt(Bytes answer);
    void deliver();
    void deliverAll(Client& client);
    void flood(Client& client);
    void annoy(Client& client);
    Bytes mutilated();
    Bytes anything(std::size_t size);
    std::size_t below(std::size_t limit) { return std::uniform_int_distribution<std::size_t>(0, limit - 1)(_random); }

    MainQueue& _queue;
    MessagePorts& _ports;
    const Fault _fault;
    const Technology _technology;
    const std::vector<Bytes> _messages;
    std::mt19937 _random{1};
    std::list<Client> _clients;
    std::unique_ptr<LocalPort> _control;
    std::unique_ptr<RepeatingTimer> _timer;
    int _answers = 0;
};

}  // namespace kelvo::soak
