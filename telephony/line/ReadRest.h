#pragma once

#include <QElapsedTimer>
#include <QIODevice>
#include <QTimer>

namespace kelvo {

/// Lets a stream of many small pieces gather at its device: after a turn that read little, shortly after another one,
/// the device is not watched for 40 ms. A modem that sends each record by itself would else wake the service up a
/// thousand times a second, which costs more than its records. Main queue only.
class ReadRest {
public:
    /// `device` outlives this object.
    explicit ReadRest(QIODevice& device);

    /// Whether the device may rest at all; not at first.
    void setAllowed(bool allowed);
    /// A turn has read so many bytes, all that there were.
    void after(std::size_t bytes);

private:
    void watch(bool watched);

    QIODevice& _device;
    QTimer _timer;
    QElapsedTimer _last;  // turn
    bool _allowed = false;
};

}  // namespace kelvo
