#include "app/command_line.h"

#include <QCommandLineParser>
#include <QStringList>

namespace app {

namespace {

// Arguments are bytes. Carried through the parser as Latin-1 they come back unchanged, so a
// folder name that is no valid UTF-8 still names the same folder.
QString fromBytes(const char* bytes) {
    return QString::fromLatin1(bytes);
}
std::string toBytes(const QString& text) {
    return text.toLatin1().toStdString();
}

}  // namespace

CommandLine parseCommandLine(int argc, const char* const* argv) {
    QCommandLineParser parser;
    parser.setApplicationDescription(
        QStringLiteral("Keeps a catalogue of the titles on your discs.\n"
                       "The data folder is --data, else $PEMLA_DATA, else $XDG_DATA_HOME/pemla\n"
                       "(by default ~/.local/share/pemla)."));
    const QCommandLineOption help({QStringLiteral("h"), QStringLiteral("help")},
                                  QStringLiteral("Shows this help and ends."));
    const QCommandLineOption version({QStringLiteral("v"), QStringLiteral("version")},
                                     QStringLiteral("Shows the version and ends."));
    const QCommandLineOption data(QStringLiteral("data"),
                                  QStringLiteral("Keeps the catalogue in <folder>."),
                                  QStringLiteral("folder"));
    // The toolkit's own options, taken by it when the windows are made.
    QCommandLineOption platform(QStringLiteral("platform"), QString(), QStringLiteral("name"));
    QCommandLineOption style(QStringLiteral("style"), QString(), QStringLiteral("name"));
    platform.setFlags(QCommandLineOption::HiddenFromHelp);
    style.setFlags(QCommandLineOption::HiddenFromHelp);
    parser.addOptions({help, version, data, platform, style});
    // The toolkit's options are written with one dash ("-platform offscreen").
    parser.setSingleDashWordOptionMode(QCommandLineParser::ParseAsLongOptions);

    QStringList arguments;
    for (int i = 0; i < argc; ++i) arguments << fromBytes(argv[i]);
    if (arguments.isEmpty()) arguments << QStringLiteral("pemla");

    // The parser names the program by how it was started; the usage names it by its name.
    QString usage = parser.helpText();
    usage = QStringLiteral("Usage: pemla [options]") + usage.mid(usage.indexOf(u'\n'));

    CommandLine result;
    const bool parsed = parser.parse(arguments);
    for (const QString& argument : parser.positionalArguments()) {
        result.positional.push_back(toBytes(argument));
    }
    if (!parsed || !result.positional.empty()) {
        result.action = CommandLine::Action::Error;
        const QString reason =
            parsed
                ? QStringLiteral("Unexpected argument '%1'.").arg(parser.positionalArguments()[0])
                : parser.errorText();
        result.output = toBytes(QStringLiteral("pemla: %1\n%2").arg(reason, usage));
        return result;
    }
    if (parser.isSet(help)) {
        result.action = CommandLine::Action::Help;
        result.output = toBytes(usage);
    } else if (parser.isSet(version)) {
        result.action = CommandLine::Action::Version;
        result.output = "pemla " PEMLA_VERSION "\n";
    }
    if (parser.isSet(data)) result.dataFolder = toBytes(parser.value(data));
    return result;
}

}  // namespace app
