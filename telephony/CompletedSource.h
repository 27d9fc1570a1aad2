#pragma once

#include <memory>

#include "telephony/PhoneSource.h"
#include "telephony/RecordSource.h"

namespace kelvo {

/// A modem's port, completed by what the phone's own services know: SIM, cells and data contexts from these,
/// measurements from the port. While the port gives nothing, these measure too.
class CompletedSource final : public RecordSource, private RecordSink {
public:
    /// `node` is the path of the port's node; empty: it is looked for; none: it has none. `lastIdle` tells what the
    /// port last sent of a cell.
    CompletedSource(std::unique_ptr<RecordSource> port, std::unique_ptr<PhoneSource> phone,
                    std::optional<std::string> node, phone::LastIdle lastIdle);

    std::optional<Technology> technology() const override;
    void findTechnology() override { _port->findTechnology(); }
    std::string description() const override;
    std::string state() const override;
    DictionaryRef portStatus() const override { return _port->portStatus(); }
    DictionaryRef phoneStatus() const override { return _phone->phoneStatus(); }

    void start(RecordSink& sink) override;
    void feed() override;
    void clientsWant(const ClientsWishes& wishes) override;
    void end(std::function<void()> done) override;

private:
    bool take(ByteView record) override;
    bool isHungry() const override { return _sink->isHungry(); }
    std::string conflict() const;
    void tellConflict();

    const std::unique_ptr<RecordSource> _port;
    const std::unique_ptr<PhoneSource> _phone;
    const std::optional<std::string> _node;
    RecordSink* _sink = nullptr;
    std::string _conflictTold;
};

}  // namespace kelvo
