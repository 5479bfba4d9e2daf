#include "selection/grid_layout.h"

#include <QFile>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QSaveFile>

#include "util/errors.h"

namespace zv {
namespace {

const QString kLayouts = QStringLiteral("layouts");

QJsonObject ReadRoot(const QString& file) {
    QFile f(file);
    if (!f.open(QIODevice::ReadOnly)) {
        throw MakeError(err::FileNotFound);
    }
    QJsonParseError parseError{};
    const auto doc = QJsonDocument::fromJson(f.readAll(), &parseError);
    if (parseError.error != QJsonParseError::NoError || !doc.isObject()) {
        throw VbError(5, QStringLiteral("Invalid layout file: ") + file);
    }
    return doc.object();
}

}  // namespace

QString BasicLayoutName() {
    return QStringLiteral("תבנית בסיסית");
}

GridColumns ClientColumns() {
    return {
        {QStringLiteral("מספר"), QStringLiteral("NUM"), 90, true},
        {QStringLiteral("שם פרטי"), QStringLiteral("F_NAME"), 140, true},
        {QStringLiteral("שם משפחה"), QStringLiteral("L_NAME"), 160, true},
        {QString(), QString(), 50, true},
        {QStringLiteral("טלפון"), QStringLiteral("TELEFON"), 110, true},
    };
}

GridColumns NamesColumns() {
    return {
        {QStringLiteral("סיווג הרשומה"), QStringLiteral("OptKey"), 110, true},
        {QStringLiteral("שם פרטי"), QStringLiteral("F_NAME"), 120, true},
        {QStringLiteral("שם משפחה"), QStringLiteral("L_NAME"), 140, true},
        {QString(), QString(), 50, true},
        {QStringLiteral("לקוח"), QStringLiteral("LakNum"), 70, true},
        {QStringLiteral("תיק"), QStringLiteral("TIK"), 70, true},
        {QStringLiteral("קוד זהוי"), QStringLiteral("CODE"), 80, true},
        {QStringLiteral("טלפון"), QStringLiteral("TELEFON"), 100, true},
        {QStringLiteral("סיווג פרטי"), QStringLiteral("TIK_ID"), 70, false},
    };
}

GridColumns LoadLayout(const QString& file, const QString& name) {
    const auto layout = ReadRoot(file).value(kLayouts).toObject().value(name);
    if (!layout.isArray() || layout.toArray().isEmpty()) {
        throw VbError(5, QStringLiteral("No layout named ") + name);
    }
    GridColumns columns;
    for (const auto& item : layout.toArray()) {
        const auto o = item.toObject();
        if (!o.value(QStringLiteral("field")).isString()) {
            throw VbError(5, QStringLiteral("Invalid layout file: ") + file);
        }
        columns.push_back({o.value(QStringLiteral("caption")).toString(),
                           o.value(QStringLiteral("field")).toString(),
                           o.value(QStringLiteral("width")).toInt(100),
                           o.value(QStringLiteral("visible")).toBool(true)});
    }
    return columns;
}

void SaveLayout(const QString& file, const QString& name, const GridColumns& columns) {
    QJsonObject root;
    if (QFile::exists(file)) {
        try {
            root = ReadRoot(file);
        } catch (const VbError&) {
            // An unreadable file holds nothing worth keeping; it is replaced.
        }
    }
    QJsonArray array;
    for (const auto& c : columns) {
        array.append(QJsonObject{{QStringLiteral("caption"), c.caption},
                                 {QStringLiteral("field"), c.field},
                                 {QStringLiteral("width"), c.width},
                                 {QStringLiteral("visible"), c.visible}});
    }
    auto layouts = root.value(kLayouts).toObject();
    layouts.insert(name, array);
    root.insert(kLayouts, layouts);

    QSaveFile out(file);
    if (!out.open(QIODevice::WriteOnly) ||
        out.write(QJsonDocument(root).toJson(QJsonDocument::Indented)) < 0 || !out.commit()) {
        throw MakeError(err::PathFileAccess);
    }
}

}  // namespace zv
