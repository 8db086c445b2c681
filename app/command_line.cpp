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
                       "(by default ~/.local/share/pemla).\n\n"
                       "Commands (no display needed):\n"
                       "  export LIST   Writes the list's report to standard output or --output:\n"
                       "                the text report, --html the HTML page (the export\n"
                       "                dialog's other settings apply), or --csv a CSV file.\n"
                       "  import LIST FILE.csv\n"
                       "                Adds the rows of a CSV file to the list (created when\n"
                       "                missing) as the Add button would, in one go."));
    const QCommandLineOption help({QStringLiteral("h"), QStringLiteral("help")},
                                  QStringLiteral("Shows this help and ends."));
    const QCommandLineOption version({QStringLiteral("v"), QStringLiteral("version")},
                                     QStringLiteral("Shows the version and ends."));
    const QCommandLineOption data(QStringLiteral("data"),
                                  QStringLiteral("Keeps the catalogue in <folder>."),
                                  QStringLiteral("folder"));
    const QCommandLineOption html(QStringLiteral("html"),
                                  QStringLiteral("export: the HTML page instead of the text."));
    const QCommandLineOption articles(QStringLiteral("article-numbers"),
                                      QStringLiteral("export: with the article numbers."));
    const QCommandLineOption csv(QStringLiteral("csv"),
                                 QStringLiteral("export: CSV (UTF-8) instead of the report."));
    const QCommandLineOption output(
        QStringLiteral("output"), QStringLiteral("export: writes to <file>, not standard output."),
        QStringLiteral("file"));
    // The toolkit's own options, taken by it when the windows are made.
    QCommandLineOption platform(QStringLiteral("platform"), QString(), QStringLiteral("name"));
    QCommandLineOption style(QStringLiteral("style"), QString(), QStringLiteral("name"));
    platform.setFlags(QCommandLineOption::HiddenFromHelp);
    style.setFlags(QCommandLineOption::HiddenFromHelp);
    parser.addOptions({help, version, data, html, articles, csv, output, platform, style});
    // The toolkit's options are written with one dash ("-platform offscreen").
    parser.setSingleDashWordOptionMode(QCommandLineParser::ParseAsLongOptions);

    QStringList arguments;
    for (int i = 0; i < argc; ++i) arguments << fromBytes(argv[i]);
    if (arguments.isEmpty()) arguments << QStringLiteral("pemla");

    // The parser names the program by how it was started; the usage names it by its name.
    QString usage = parser.helpText();
    usage = QStringLiteral(
                "Usage: pemla [options]\n"
                "       pemla [--data <folder>] export LIST [--html] [--article-numbers]"
                " [--csv] [--output <file>]\n"
                "       pemla [--data <folder>] import LIST FILE.csv") +
            usage.mid(usage.indexOf(u'\n'));

    CommandLine result;
    const bool parsed = parser.parse(arguments);
    for (const QString& argument : parser.positionalArguments()) {
        result.positional.push_back(toBytes(argument));
    }
    const std::vector<std::string>& words = result.positional;
    const bool exporting = !words.empty() && words[0] == "export";
    const bool importing = !words.empty() && words[0] == "import";
    QString reason;
    if (!parsed) {
        reason = parser.errorText();
    } else if (exporting && words.size() != 2) {
        reason = QStringLiteral("export takes one list name.");
    } else if (importing && words.size() != 3) {
        reason = QStringLiteral("import takes a list name and a CSV file.");
    } else if (!exporting && !importing && !words.empty()) {
        reason = QStringLiteral("Unexpected argument '%1'.").arg(parser.positionalArguments()[0]);
    } else if (parser.isSet(html) && parser.isSet(csv)) {
        reason = QStringLiteral("--html and --csv cannot go together.");
    } else if (!exporting) {
        for (const QCommandLineOption* option : {&html, &articles, &csv, &output}) {
            if (parser.isSet(*option)) {
                reason = QStringLiteral("--%1 goes with export only.").arg(option->names()[0]);
            }
        }
    }
    if (!reason.isEmpty()) {
        result.action = CommandLine::Action::Error;
        result.output = toBytes(QStringLiteral("pemla: %1\n%2").arg(reason, usage));
        return result;
    }
    if (exporting || importing) {
        result.action = exporting ? CommandLine::Action::Export : CommandLine::Action::Import;
        result.list = words[1];
        if (importing) result.file = words[2];
        result.html = parser.isSet(html);
        result.articleNumbers = parser.isSet(articles);
        result.csv = parser.isSet(csv);
        if (parser.isSet(output)) result.outputFile = toBytes(parser.value(output));
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
