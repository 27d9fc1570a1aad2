// Draws the main screens into a directory, light and dark, without a display:
// kelvo_screenshots DIRECTORY [WIDTH HEIGHT]
#include <QDir>
#include <QGuiApplication>
#include <QTest>
#include <cstdio>
#include <cstdlib>

#include "tests/ui/Scene.h"

namespace kelvo::test {
namespace {

Value leaves(std::initializer_list<std::pair<std::string_view, Value>> entries) { return Dictionary::make(entries); }

Value neighbor(const char* cell, const char* rsrp, const char* rsrq) {
    return leaves({{"Physical Cell ID", cell}, {"Filtered RSRP", rsrp}, {"Filtered RSRQ", rsrq}});
}

Value readings() {
    return leaves({
        {"Serving Cell Info", leaves({{"Physical Cell ID", "301"},
                                      {"Cell Identity", "27447297"},
                                      {"Tracking Area Code", "12801"},
                                      {"Freq Band Indicator", "3"},
                                      {"Download Frequency", "1300"},
                                      {"Upload Frequency", "19300"},
                                      {"Download Bandwidth", "20 MHz"},
                                      {"Upload Bandwidth", "20 MHz"},
                                      {"Num Tx Antennas", "2"}})},
        {"Serving Cell Measurements", leaves({{"E-ARFCN", "1300"},
                                              {"Measured RSRP", "-95.56 dBm"},
                                              {"Average RSRP", "-96.13 dBm"},
                                              {"Measured RSRQ", "-9.44 dB"},
                                              {"Average RSRQ", "-9.81 dB"},
                                              {"Measured RSSI", "-67.31 dBm"},
                                              {"Srxlev", "27 dB"},
                                              {"S Intra Search", "62 dB"},
                                              {"Num of Consecutive DRX Cycles of S < 0", "0"},
                                              {"Measurement Rules", "Intra-frequency and inter-frequency, always"},
                                              {"Version", "1"}})},
        {"Connected mode LTE Intra-frequency Measurement",
         leaves({{"Serving Filtered RSRP", "-95.31 dBm"}, {"Serving Filtered RSRQ", "-9.50 dB"}})},
        {"Measured Neighbor Cells",
         Array::make({"", neighbor("302", "-101.25 dBm", "-12.50 dB"), neighbor("417", "-104.00 dBm", "-13.25 dB"),
                      neighbor("88", "-110.50 dBm", "-16.00 dB")})},
        {"Detected Neighbor Cells", Array::make({""})},
        {"PDP Contexts", leaves({{"APN", "internet"}, {"Address", "10.64.3.17"}})},
        {"Registration", "Registered, home network"},
    });
}

class Shooter {
public:
    Shooter(QString directory, QSize size, bool dark) : _directory(std::move(directory)), _size(size), _dark(dark) {}

    void all() {
        Scene::useDarkColours(_dark);
        panes();
        saving();
    }

private:
    void shoot(Scene& scene, const char* name) {
        scene.settle();
        QTest::qWait(400);  // until what fades has faded
        const QString file =
            QStringLiteral("%1/%2-%3.png").arg(_directory, QLatin1String(name), _dark ? "dark" : "light");
        if (!scene.view().grabWindow().save(file)) std::fprintf(stderr, "cannot write %s\n", qPrintable(file));
    }

    void panes() {
        Scene scene(true, _size);
        Scene::useDarkColours(_dark);
        shoot(scene, "connecting");
        scene.connect();
        scene.show(readings());
        shoot(scene, "sections");
        scene.tapText("Serving Cell Measurements");
        shoot(scene, "measurements");
        scene.press(Qt::Key_Escape);
        scene.settle();
        scene.tapText("Measured Neighbor Cells");
        shoot(scene, "neighbors");
        scene.press(Qt::Key_Escape);
        scene.settle();
        scene.tapText("Detected Neighbor Cells");
        shoot(scene, "empty");
        scene.press(Qt::Key_Escape);
        scene.settle();
        scene.press(Qt::Key_Down);
        scene.press(Qt::Key_Down);
        shoot(scene, "keyboard");
    }

    void saving() {
        Scene scene(true, _size);
        Scene::useDarkColours(_dark);
        scene.connect();
        for (int i = 0; i < 4; ++i) scene.show(readings());
        std::filesystem::remove(scene.snapshotDirectory());
        scene.settle();
        scene.tapText("Save");
        shoot(scene, "save");
        scene.tapText("Description");
        scene.type("drive");
        shoot(scene, "save-description");
        scene.app().saveViewController()->savePressed();
        scene.connect();
        shoot(scene, "alert");
    }

    QString _directory;
    QSize _size;
    bool _dark;
};

}  // namespace
}  // namespace kelvo::test

int main(int argc, char** argv) {
    if (argc != 2 && argc != 4) return std::fprintf(stderr, "usage: kelvo_screenshots DIRECTORY [WIDTH HEIGHT]\n"), 2;
    qputenv("QT_QPA_PLATFORM", "offscreen");
    qputenv("QT_QUICK_BACKEND", "software");
    QGuiApplication application(argc, argv);
    const QString directory = QString::fromLocal8Bit(argv[1]);
    QDir().mkpath(directory);
    const QSize size = argc == 4 ? QSize(std::atoi(argv[2]), std::atoi(argv[3])) : QSize(360, 640);
    for (const bool dark : {false, true}) kelvo::test::Shooter(directory, size, dark).all();
    return 0;
}
