// ryx-demo: the demo report-selection screen.
//
//   ryx-demo [--database FILE] [--form FILE]     opens the screen
//   ryx-demo --script [--screenshot FILE.png]    a short scripted session (offscreen when
//                                                there is no display): prints each control's
//                                                criterion and writes a screenshot
//   ryx-demo --print-on-exit                     prints the criteria when the window closes
#include <QApplication>
#include <QCommandLineParser>
#include <QDir>
#include <QStyleFactory>
#include <cstdio>
#include <iostream>

#include "demo_window.h"
#include "ryx/sqlite/sqlite_record_source.h"
#include "scripted_session.h"

namespace {

// The offscreen platform warns about what it cannot do for a window; the session needs none of it.
void quietOffscreenWarnings(QtMsgType type, const QMessageLogContext&, const QString& message) {
    if (message.contains("propagateSizeHints") || message.contains("XDG_RUNTIME_DIR")) return;
    std::cerr << (type == QtWarningMsg ? "warning: " : "") << message.toStdString() << "\n";
}

bool haveDisplay() {
    return !qEnvironmentVariableIsEmpty("DISPLAY") ||
           !qEnvironmentVariableIsEmpty("WAYLAND_DISPLAY");
}

}  // namespace

int main(int argc, char** argv) {
    bool script = false;
    for (int i = 1; i < argc; ++i)
        if (QString(argv[i]) == "--script") script = true;
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM") && (script || !haveDisplay())) {
        qputenv("QT_QPA_PLATFORM", "offscreen");
        script = true;
    }
    if (script) qInstallMessageHandler(quietOffscreenWarnings);

    QApplication app(argc, argv);
    QApplication::setApplicationName("ryx-demo");
    QApplication::setStyle(QStyleFactory::create("Fusion"));

    QCommandLineParser options;
    options.setApplicationDescription("The RYXReport demo report-selection screen");
    options.addHelpOption();
    options.addOption({"database", "The agency database (SQLite).", "file", RYX_SAMPLE_DATABASE});
    options.addOption({"form", "A form file to load at start.", "file"});
    options.addOption({"script", "Run a short scripted session and print the criteria."});
    options.addOption({"screenshot", "Where the scripted session saves its screenshot.", "png",
                       QDir::temp().filePath("ryx-demo.png")});
    options.addOption({"print-on-exit", "Print the criteria when the window closes."});
    options.process(app);

    ryx::qt::ControlHost::setRecordSourceFactory(ryx::sqlite::makeRecordSource);
    DemoWindow window(options.value("database"));
    if (options.isSet("form")) window.loadForm(options.value("form"));
    window.resize(1040, 330);
    window.show();

    if (script) return runScriptedSession(window, options.value("screenshot"));

    const int status = app.exec();
    if (options.isSet("print-on-exit")) std::cout << window.criteria().toStdString() << std::flush;
    return status;
}
