#include "sample_install/sample_data.h"

#include <QMap>
#include <array>

namespace zv {

namespace {

QVariant Text(const char* utf8) {
    return utf8 ? QVariant(QString::fromUtf8(utf8)) : QVariant(QMetaType(QMetaType::QString));
}
const QVariant kNullText = QVariant(QMetaType(QMetaType::QString));

struct BaseClient {
    const char* num;
    const char* firstName;  // null: a company or an unnamed client
    const char* lastName;
    const char* telefon;
};

// Clients with and without first names, apostrophes and a double quote in names, and one
// without any name.
constexpr std::array kBaseClients{
    BaseClient{"1001", "ישראל", "ישראלי", "03-5551234"},
    BaseClient{"1002", nullptr, "עיריית חולון", "03-5021111"},
    BaseClient{"1003", "ג'ורג'", "ג'בארה", "04-8123456"},
    BaseClient{"1004", "Shaun", "O'Neil", "09-7654321"},
    BaseClient{"1005", "שרה", "לוי", "02-6234567"},
    BaseClient{"1006", "דוד", "כהן", "050-1234567"},
    BaseClient{"1007", "רחל", "אברהם", "052-7654321"},
    BaseClient{"1008", nullptr, "בנק הפועלים בע\"מ", "03-5673333"},
    BaseClient{"1009", "משה", "פרץ", nullptr},
    BaseClient{"1010", "יעל", "מזרחי", "08-9345678"},
    BaseClient{"1011", "אבי", "ביטון", "04-6401234"},
    BaseClient{"1012", nullptr, nullptr, "03-0000000"},
};

// The kind letter stored with a names row of each kind (OptKey).
QString SugOfKind(int optKey) {
    static const QMap<int, QString> sug{
        {0, "F"},  {1, "N"},  {2, "W"},  {3, "G"},  {4, "H"},  {5, "L"},  {6, "H"},
        {7, "L"},  {8, "H"},  {9, "S"},  {10, "L"}, {11, "T"}, {12, "H"}, {13, "H"},
        {14, "H"}, {15, "A"}, {16, "A"}, {17, "N"}, {18, "M"},
    };
    return sug.value(optKey);
}

struct BaseCase {
    const char* client;
    int optKey;
    const char* tikId;  // sub-kind number; for a general case (11) the MTIK row's ID
    const char* sug;    // null: the letter of the kind
    const char* firstName;
    const char* lastName;
    const char* telefon;
};

// Cases of every kind from 1 to 18. Client 1001 has each kind of a client's own list;
// kind 17 appears with a known and with an unknown letter; kind 11 with shown, hidden
// and missing user-defined kinds; kind 4 with a blank sub-kind.
constexpr std::array kBaseCases{
    BaseCase{"1001", 1, nullptr, nullptr, "ישראל", "ישראלי", "03-5551234"},
    BaseCase{"1001", 2, nullptr, nullptr, "ישראל", "ישראלי", "03-5551234"},
    BaseCase{"1001", 3, nullptr, nullptr, "ישראל", "ישראלי", "03-5551234"},
    BaseCase{"1001", 4, "2", nullptr, "ישראל", "ישראלי", "03-5551234"},
    BaseCase{"1001", 5, nullptr, nullptr, "ישראל", "ישראלי", "03-5551234"},
    BaseCase{"1001", 6, "1", nullptr, "ישראל", "ישראלי", "03-5551234"},
    BaseCase{"1001", 10, nullptr, nullptr, "ישראל", "ישראלי", "03-5551234"},
    BaseCase{"1001", 11, "26", nullptr, "ישראל", "ישראלי", "03-5551234"},
    BaseCase{"1001", 11, "27", nullptr, "ישראל", "ישראלי", "03-5551234"},
    BaseCase{"1002", 4, "", nullptr, nullptr, "עיריית חולון", "03-5021111"},
    BaseCase{"1002", 7, nullptr, nullptr, nullptr, "עיריית חולון", "03-5021111"},
    BaseCase{"1002", 8, "3", nullptr, nullptr, "עיריית חולון", "03-5021111"},
    BaseCase{"1002", 12, "1", nullptr, nullptr, "עיריית חולון", "03-5021111"},
    BaseCase{"1002", 13, "2", nullptr, nullptr, "עיריית חולון", "03-5021111"},
    BaseCase{"1002", 14, "1", nullptr, nullptr, "עיריית חולון", "03-5021111"},
    BaseCase{"1002", 11, "28", nullptr, nullptr, "עיריית חולון", "03-5021111"},
    BaseCase{"1002", 11, "29", nullptr, nullptr, "עיריית חולון", "03-5021111"},
    BaseCase{"1002", 11, "40", nullptr, nullptr, "עיריית חולון", "03-5021111"},
    BaseCase{"1003", 1, nullptr, nullptr, "ג'ורג'", "ג'בארה", "04-8123456"},
    BaseCase{"1003", 11, "26", nullptr, "ג'ורג'", "ג'בארה", "04-8123456"},
    BaseCase{"1003", 9, nullptr, nullptr, "ג'ורג'", "ג'בארה", "04-8123456"},
    BaseCase{"1004", 2, nullptr, nullptr, "Shaun", "O'Neil", "09-7654321"},
    BaseCase{"1004", 3, nullptr, nullptr, "Shaun", "O'Neil", "09-7654321"},
    BaseCase{"1005", 15, nullptr, nullptr, "יוסי", "רוזן", "054-3332211"},
    BaseCase{"1005", 16, nullptr, nullptr, "מוקד", "עירוני", "106"},
    BaseCase{"1005", 17, nullptr, "W", "אורי", "שטרן", "03-6112233"},
    BaseCase{"1005", 17, nullptr, "X", "נועה", "גולן", "03-6114455"},
    BaseCase{"1005", 18, nullptr, nullptr, "ד\"ר עמית", "ברק", "03-6998877"},
    BaseCase{"1006", 1, nullptr, nullptr, "דוד", "כהן", "050-1234567"},
    BaseCase{"1007", 10, nullptr, nullptr, "רחל", "אברהם", "052-7654321"},
    BaseCase{"1008", 5, nullptr, nullptr, nullptr, "בנק הפועלים בע\"מ", "03-5673333"},
};

constexpr std::array kFirstNames{
    "אברהם", "יצחק",  "יעקב", "שרה",  "רבקה",  "רחל",  "לאה",    "משה",    "אהרן",  "מרים",
    "דוד",   "שלמה",  "אסתר", "רות",  "נעמי",  "יוסף", "בנימין", "דינה",   "חנה",   "שמואל",
    "אליהו", "אלישע", "עמוס", "הושע", "יונה",  "מיכל", "תמר",    "אביגיל", "יעל",   "דבורה",
    "גדעון", "שמשון", "נתן",  "עזרא", "נחמיה", "איתי", "נועה",   "עומר",   "ליאור", "שירה",
};
constexpr std::array kLastNames{
    "כהן",     "לוי",    "מזרחי",  "פרץ",     "ביטון",    "דהן",   "אברהם",    "פרידמן",  "אגבריה",
    "מלכה",    "אזולאי", "כץ",     "יוסף",    "דוד",      "עמר",   "אוחיון",   "חדד",     "גבאי",
    "שפירא",   "בן דוד", "חורי",   "מרקוביץ", "גולן",     "שטרן",  "רוזן",     "ברק",     "נחום",
    "סויסה",   "קליין",  "ויס",    "ג'אבר",   "אלון",     "שושן",  "טל",       "זילברמן", "אוחנה",
    "ששון",    "יעקב",   "אדלר",   "וקנין",   "בירנבאום", "לנדאו", "הרשקוביץ", "מנסור",   "עבאס",
    "חביב",    "סלאמה",  "נסים",   "שרעבי",   "צור",      "אלמוג", "רבינוביץ", "גרינברג", "פישר",
    "ליבוביץ", "ממן",    "אשכנזי", "סעדה",    "בוזגלו",   "חיים",
};
constexpr std::array kCompanies{
    "בע\"מ", "ושות'", "אחזקות בע\"מ", "נכסים בע\"מ", "יזמות", "סחר ושיווק",
};

// Kinds of generated names rows, weighted towards the kinds of a client's own list.
constexpr std::array kGeneratedKinds{1, 2, 3,  4,  5,  10, 11, 1, 2,  6,  8, 12, 13, 14,
                                     7, 9, 15, 16, 17, 18, 1,  3, 11, 10, 4, 5,  2,  1};

const char* Pick(const auto& pool, long long i) {
    return pool[static_cast<std::size_t>(i % static_cast<long long>(pool.size()))];
}

QString GeneratedClientNum(long long i) {
    return QString::number(10001 + i);
}

// Generated client i: about one in seven is a company without a first name.
struct GeneratedName {
    QVariant firstName;
    QVariant lastName;
    QVariant telefon;
};
GeneratedName GeneratedClient(long long i) {
    GeneratedName n;
    const long long mix = i * 7919 + 13;
    if (i % 7 == 3) {
        n.firstName = kNullText;
        n.lastName = QString::fromUtf8(Pick(kLastNames, mix / 3)) + QLatin1Char(' ') +
                     QString::fromUtf8(Pick(kCompanies, i));
    } else {
        n.firstName = QString::fromUtf8(Pick(kFirstNames, mix));
        n.lastName = QString::fromUtf8(Pick(kLastNames, mix / 5));
    }
    n.telefon = QStringLiteral("0%1-%2").arg(2 + i % 8).arg(1000000 + (mix * 31) % 9000000, 7, 10,
                                                            QLatin1Char('0'));
    return n;
}

void Row(const RowSink& sink, std::initializer_list<QVariant> values) {
    sink(QVariantList(values));
}

}  // namespace

SampleData::SampleData(const SampleOptions& options) : options_(options) {}

int SampleData::BaseClientCount() {
    return static_cast<int>(kBaseClients.size());
}

int SampleData::BaseLookForCount() {
    return static_cast<int>(kBaseClients.size() + kBaseCases.size());
}

const QList<SampleTable>& SampleData::Tables() {
    static const QList<SampleTable> tables{
        {"OFFICE", "MTIK", {"ID", "TEUR", "SHOW"}},
        {"OFFICE", "OFF_CODE", {"CODE", "NUM", "Teur"}},
        {"OFFICE", "CLIENT", {"NUM", "F_NAME", "L_NAME", "TELEFON"}},
        {"MDOCS", "DOCSTATUS", {"ID", "Caption", "ORD"}},
        {"ZORVA",
         "LOOKFOR",
         {"LakNum", "OptKey", "Sug", "Tik", "Code", "TIK_ID", "F_NAME", "L_NAME", "TELEFON"}},
        {"MADAD", "TRANS_CODE", {"TABLE_NUM", "KOD_NUM_1", "Teur"}},
        {"MAIN",
         "MSql",
         {"ClientID", "IsDocs", "IsBM", "IsOffice", "IsZorva", "IsNetM", "IsCalt", "IsCGam",
          "IsLogin", "IsDirect", "IsPub", "IsRData", "IsSalvi32", "IsProgram"}},
        {"PUB", "USERS", {"USERCODE", "ST_NUMBER", "UserName"}},
    };
    return tables;
}

void SampleData::Rows(const QString& table, const RowSink& sink) const {
    if (table == QLatin1String("MTIK")) {
        // User-defined case kinds are numbered from 26; a hidden one is not in the catalogue.
        Row(sink, {26, Text("תיקי ירושה"), 1});
        Row(sink, {27, Text("תיקי משפחה"), 1});
        Row(sink, {28, Text("  תיקי הוצאה לפועל  "), 1});
        Row(sink, {29, Text("תיקי ארכיון"), 0});
    } else if (table == QLatin1String("OFF_CODE")) {
        int num = 0;
        for (const char* teur : {"מכתב", "חוזה", "כתב תביעה", "כתב הגנה", "פסק דין", "חשבונית"})
            Row(sink, {20, ++num, Text(teur)});
        num = 0;
        // Quotes and a backslash as users type them.
        for (const char* teur : {"מקור", "העתק", "טיוטה", "סרוק", "העתק \"נאמן למקור\" \\ סרוק"})
            Row(sink, {21, ++num, Text(teur)});
        Row(sink, {5, 1, Text("סניף ראשי")});
    } else if (table == QLatin1String("CLIENT")) {
        ClientRows(sink);
    } else if (table == QLatin1String("DOCSTATUS")) {
        Row(sink, {1, Text("חדש"), 1});
        Row(sink, {2, Text("בטיפול"), 2});
        Row(sink, {3, Text("סגור"), 4});
        Row(sink, {4, Text("ממתין לתגובה"), 3});
    } else if (table == QLatin1String("LOOKFOR")) {
        LookForRows(sink);
    } else if (table == QLatin1String("TRANS_CODE")) {
        int kod = 0;
        for (const char* teur : {"דואר", "פקס", "דואר אלקטרוני", "מסירה ידנית", "סריקה", "בית משפט",
                                 "לקוח", "צד שכנגד", "הוצאה לפועל", "אחר"})
            Row(sink, {Text("1080"), QString::number(++kod), Text(teur)});
        Row(sink, {Text("1070"), Text("1"), Text("קוד של טבלה אחרת")});
    } else if (table == QLatin1String("MSql")) {
        MSqlRows(sink);
    } else if (table == QLatin1String("USERS")) {
        UserRows(sink);
    }
}

void SampleData::ClientRows(const RowSink& sink) const {
    for (const BaseClient& c : kBaseClients)
        Row(sink, {Text(c.num), Text(c.firstName), Text(c.lastName), Text(c.telefon)});
    const long long generated = std::max(0, options_.clients - BaseClientCount());
    for (long long i = 0; i < generated; ++i) {
        const GeneratedName n = GeneratedClient(i);
        Row(sink, {GeneratedClientNum(i), n.firstName, n.lastName, n.telefon});
    }
}

void SampleData::LookForRows(const RowSink& sink) const {
    for (const BaseClient& c : kBaseClients) {
        Row(sink, {Text(c.num), 0, SugOfKind(0), kNullText, kNullText, kNullText, Text(c.firstName),
                   Text(c.lastName), Text(c.telefon)});
    }
    QMap<QString, int> casesOfClient;
    for (const BaseCase& c : kBaseCases) {
        const QString client = QString::fromUtf8(c.client);
        const QString tik = QString::number(++casesOfClient[client]);
        const QString sug = c.sug ? QString::fromUtf8(c.sug) : SugOfKind(c.optKey);
        Row(sink, {client, c.optKey, sug, tik, client + QLatin1Char('-') + tik, Text(c.tikId),
                   Text(c.firstName), Text(c.lastName), Text(c.telefon)});
    }

    long long remaining = std::max(0, options_.lookfor - BaseLookForCount());
    const long long clients = std::max(0, options_.clients - BaseClientCount());
    // Each generated client first gets its own client row.
    for (long long i = 0; i < clients && remaining > 0; ++i, --remaining) {
        const GeneratedName n = GeneratedClient(i);
        Row(sink, {GeneratedClientNum(i), 0, SugOfKind(0), kNullText, kNullText, kNullText,
                   n.firstName, n.lastName, n.telefon});
    }
    // Then cases, spread round the generated clients (or the built-in ones).
    const long long owners = clients > 0 ? clients : BaseClientCount();
    for (long long j = 0; remaining > 0; ++j, --remaining) {
        const long long owner = j % owners;
        const QString client =
            clients > 0 ? GeneratedClientNum(owner) : QString::fromUtf8(kBaseClients[owner].num);
        const GeneratedName n = clients > 0 ? GeneratedClient(owner) : GeneratedClient(j);
        const int kind = kGeneratedKinds[static_cast<std::size_t>(j % kGeneratedKinds.size())];
        const QString tik = QString::number(1000 + j / owners);
        QVariant tikId = kNullText;
        if (SugOfKind(kind) == QLatin1String("H"))
            tikId = QString::number(1 + j % 3);
        else if (kind == 11)
            tikId = QString::number(26 + j % 3);
        Row(sink, {client, kind, SugOfKind(kind), tik, client + QLatin1Char('-') + tik, tikId,
                   n.firstName, n.lastName, n.telefon});
    }
}

void SampleData::MSqlRows(const RowSink& sink) const {
    const bool server = !options_.serverDataSource.isEmpty();
    auto flag = [server](bool on) { return server && on ? 1 : 0; };
    Row(sink,
        {options_.volnaGlobNum, flag(options_.onServerDocs), flag(options_.onServerBM),
         flag(options_.onServerOffice), flag(options_.onServerZorva), 0, 0, 0, 0, 0, 0, 0, 0, 0});
    // Another installation's row, all on the server, to show that only this one counts.
    if (options_.volnaGlobNum != QLatin1String("99999"))
        Row(sink, {Text("99999"), 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1});
}

void SampleData::UserRows(const RowSink& sink) const {
    Row(sink, {options_.officeCode, Text("1"), options_.myUserName});
    Row(sink, {options_.officeCode, Text("2"), Text("יוסי לוי")});
    Row(sink, {options_.officeCode, Text("3"), Text("מיכל ברק")});
    Row(sink, {options_.officeCode, Text("10"), Text("עו\"ד רון שמיר")});
    Row(sink, {options_.officeCode + QStringLiteral("9"), Text("1"), Text("משתמש משרד אחר")});
}

}  // namespace zv
