#include "startup/filing_options.h"

#include <QTime>
#include <functional>
#include <map>

#include "startup/request_text.h"

namespace zv {
namespace {

// Sets one option from its value; returns an error text, or empty when the value is good.
using Setter = std::function<QString(FilingOptions&, const QString&)>;

std::optional<QDate> ParseDate(const QString& text) {
    const QDate date = QDate::fromString(text, QStringLiteral("dd-MM-yyyy"));
    return date.isValid() ? std::optional<QDate>(date) : std::nullopt;
}

QString SetDate(std::optional<QDate>& field, const QString& value) {
    field = ParseDate(value);
    return field ? QString() : QStringLiteral("not a date DD-MM-YYYY: ") + value;
}

QString SetNumber(std::optional<int>& field, const QString& value) {
    bool ok = false;
    const int n = value.toInt(&ok);
    if (!ok) {
        return QStringLiteral("not a number: ") + value;
    }
    field = n;
    return {};
}

QString SetText(QString& field, const QString& value) {
    field = value;
    return {};
}

QString SetReminder(FilingOptions& o, const QString& value) {
    const QStringList parts = value.split(QLatin1Char(' '), Qt::SkipEmptyParts);
    const QTime time =
        parts.size() == 2 ? QTime::fromString(parts.at(1), QStringLiteral("H:mm")) : QTime();
    o.reminderDate = parts.size() == 2 ? ParseDate(parts.at(0)) : std::nullopt;
    if (!o.reminderDate || !time.isValid()) {
        o.reminderDate.reset();
        return QStringLiteral("not a reminder \"DD-MM-YYYY HH:MM\": ") + value;
    }
    o.reminderTime = time.toString(QStringLiteral("HH:mm"));
    return {};
}

QString SetOnClash(FilingOptions& o, const QString& value) {
    if (value == QLatin1String("skip")) {
        o.onClash = OnClash::Skip;
    } else if (value == QLatin1String("overwrite")) {
        o.onClash = OnClash::Overwrite;
    } else {
        return QStringLiteral("--on-clash takes skip or overwrite, not: ") + value;
    }
    return {};
}

const std::map<QByteArray, Setter>& ValueOptions() {
    static const std::map<QByteArray, Setter> options{
        {"--client", [](auto& o, const auto& v) { return SetText(o.client, v); }},
        {"--case", [](auto& o, const auto& v) { return SetText(o.caseNumber, v); }},
        {"--name",
         [](auto& o, const auto& v) {
             o.name = v;
             return QString();
         }},
        {"--inner-folder", [](auto& o, const auto& v) { return SetText(o.innerFolder, v); }},
        {"--description", [](auto& o, const auto& v) { return SetText(o.description, v); }},
        {"--more-description",
         [](auto& o, const auto& v) { return SetText(o.moreDescription, v); }},
        {"--remark", [](auto& o, const auto& v) { return SetText(o.remark, v); }},
        {"--origin", [](auto& o, const auto& v) { return SetNumber(o.origin, v); }},
        {"--status", [](auto& o, const auto& v) { return SetNumber(o.status, v); }},
        {"--handlers",
         [](auto& o, const auto& v) {
             o.handlers = v;
             return QString();
         }},
        {"--received", [](auto& o, const auto& v) { return SetDate(o.received, v); }},
        {"--created", [](auto& o, const auto& v) { return SetDate(o.created, v); }},
        {"--reminder", SetReminder},
        {"--on-clash", SetOnClash},
    };
    return options;
}

}  // namespace

bool ParseFilingOption(const QList<QByteArray>& args, qsizetype& i, FilingOptions& options,
                       QString& error) {
    const QByteArray& arg = args.at(i);
    if (arg == "--number" || arg == "--popup") {
        (arg == "--number" ? options.number : options.popup) = true;
        options.given = true;
        return true;
    }
    const qsizetype eq = arg.indexOf('=');
    const QByteArray key = eq < 0 ? arg : arg.left(eq);
    const auto option = ValueOptions().find(key);
    if (option == ValueOptions().end()) {
        return false;
    }
    options.given = true;
    QByteArray value;
    if (eq >= 0) {
        value = arg.mid(eq + 1);
    } else if (i + 1 < args.size()) {
        value = args.at(++i);
    } else {
        error = QString::fromLatin1(key) + QStringLiteral(" needs a value");
        return true;
    }
    error = option->second(options, DecodeArgumentText(value));
    return true;
}

QString CheckFilingOptions(bool batch, const FilingOptions& options) {
    if (options.given && !batch) {
        return QStringLiteral("the filing options need --batch");
    }
    if (!batch) {
        return {};
    }
    if (options.popup && !options.reminderDate) {
        return QStringLiteral("--popup needs --reminder");
    }
    if (options.number && options.name) {
        return QStringLiteral("--name and --number exclude each other");
    }
    return {};
}

QString FilingOptionsUsage() {
    return QStringLiteral(
        "Filing options (with --batch; --client is required):\n"
        "  --client NUM            the client\n"
        "  --case TIK              one of the client's case files, by its case number\n"
        "  --name TEXT             document name (default: the suggested name, cleaned)\n"
        "  --number                name by consecutive numbering in the folder\n"
        "  --inner-folder NAME     file into that DOCBASIC inner folder\n"
        "  --description TEXT      --more-description TEXT      --remark TEXT\n"
        "  --origin CODE           (default 2 for a document, 1 for a mail)\n"
        "  --status ID             (default 2)\n"
        "  --handlers \"A;B\"        (default: the user's display name)\n"
        "  --received DD-MM-YYYY   (default today)\n"
        "  --created DD-MM-YYYY    the creation date\n"
        "  --reminder \"DD-MM-YYYY HH:MM\"    a reminder;  --popup  it pops up\n"
        "  --on-clash skip|overwrite        a name clash: leave the source (default) or "
        "replace\n"
        "On success the archived file's path is printed on standard output.\n");
}

}  // namespace zv
