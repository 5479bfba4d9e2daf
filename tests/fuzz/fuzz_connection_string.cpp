// The connection string: parsing any text, and the round trip of the server settings
// through GetConnectionByDbName and ParseConnectionString. Input: the whole text is parsed;
// its first four lines are also taken as data source, database name, login and password.

#include "data/connection_string.h"
#include "data/data_errors.h"
#include "fuzz_support.h"
#include "util/errors.h"
#include "util/state.h"

extern "C" int LLVMFuzzerInitialize(int*, char***) {
    zv::fuzz::InstallQuietUi();
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const QString text = QString::fromUtf8(zv::fuzz::Bytes(data, size));
    try {
        zv::ParseConnectionString(text);
    } catch (const zv::VbError& e) {
        if (e.Number() != zv::err::AdoProviderNotFound) {
            zv::fuzz::Fail("only an unknown provider is refused", text);
        }
    }

    const QStringList f = zv::fuzz::Fields(data, size, 5);
    zv::SetProvider(QStringLiteral("PostgreSQL"));
    zv::SetDataSource(f.at(0));
    zv::SetVolnaGlobNum(QString());
    zv::SetUserID(f.at(2));
    zv::SetPassWord(f.at(3));
    const QString built = zv::GetConnectionByDbName(f.at(1));
    const zv::ServerConnectionParams p = zv::ParseConnectionString(built);
    if (p.database != f.at(1) || p.user != f.at(2) || p.password != f.at(3)) {
        zv::fuzz::Fail("settings come back from their connection string unchanged", built);
    }
    return 0;
}
