#pragma once

#include <QByteArray>
#include <QHash>
#include <QLocalServer>
#include <QLocalSocket>
#include <QString>

namespace kelvo::test {

/// A modem that speaks AT commands (3GPP TS 27.007) on a Unix socket: an LTE phone of the test network, at home.
class AtModem {
public:
    explicit AtModem(const QString& path) {
        QObject::connect(&_server, &QLocalServer::newConnection, &_server, [this] {
            QLocalSocket* const line = _server.nextPendingConnection();
            QObject::connect(line, &QLocalSocket::readyRead, line, [this, line] { read(*line); });
        });
        _server.listen(path);
    }
    bool isListening() const { return _server.isListening(); }

    /// What the modem answers; a command that is not here is answered "OK", a question "ERROR".
    QHash<QByteArray, QByteArray> answers = {
        {"AT+GCAP", "+GCAP: +CGSM"},
        {"AT+CGMI", "Maker"},
        {"AT+CGMM", "AT Modem"},
        {"AT+CGMR", "1.0"},
        {"AT+CGSN", "123456789012347"},
        {"AT+WS46=?", "+WS46: (12,22,25,28,29)"},
        {"AT+CSCS=?", "+CSCS: (\"IRA\")"},
        {"AT+CFUN?", "+CFUN: 1"},
        {"AT+CPIN?", "+CPIN: READY"},
        {"AT+CIMI", "001010123456789"},
        {"AT+CNUM", "+CNUM: \"\",\"+15550123\",145"},
        {"AT+CRSM=176,12258,0,0,10", "+CRSM: 144,0,\"98101010000000214365\""},                // EF-ICCID
        {"AT+CRSM=176,28589,0,0,4", "+CRSM: 144,0,\"00000002\""},                             // EF-AD
        {"AT+CRSM=176,28486,0,0,17", "+CRSM: 144,0,\"0050726F7669646572FFFFFFFFFFFFFFFF\""},  // EF-SPN: "Provider"
        {"AT+CGDCONT=?", "+CGDCONT: (1-11),\"IP\",,,(0-2),(0-4)"},
        {"AT+CREG?", "+CREG: 2,1,\"1234\",\"000ABCDE\",7"},
        {"AT+CGREG?", "+CGREG: 2,1,\"1234\",\"000ABCDE\",7"},
        {"AT+CEREG?", "+CEREG: 2,1,\"1234\",\"000ABCDE\",7"},
        {"AT+COPS?", "+COPS: 0,2,\"00101\",7"},
        {"AT+CSQ", "+CSQ: 20,99"},
        {"AT+CESQ=?", "+CESQ: (0-63,99),(0-7,99),(0-96,255),(0-49,255),(0-34,255),(0-97,255)"},
        {"AT+CESQ", "+CESQ: 99,99,255,255,20,50"},  // RSRQ -10 dB, RSRP -91 dBm
    };

private:
    void read(QLocalSocket& line) {
        _pending += line.readAll();
        for (qsizetype end = _pending.indexOf('\r'); end >= 0; end = _pending.indexOf('\r')) {
            const QByteArray command = _pending.left(end).trimmed();
            _pending.remove(0, end + 1);
            if (!command.isEmpty()) line.write(answerTo(command));
        }
    }
    QByteArray answerTo(const QByteArray& command) const {
        if (answers.contains(command)) return "\r\n" + answers[command] + "\r\n\r\nOK\r\n";
        return command.endsWith('?') ? "\r\nERROR\r\n" : "\r\nOK\r\n";
    }

    QLocalServer _server;
    QByteArray _pending;
};

}  // namespace kelvo::test
