#pragma once
// The rows of a sample installation: a hand-written Hebrew set that covers every case the
// add-in distinguishes, plus generated clients and names up to the requested sizes.

#include <QList>
#include <QString>
#include <QStringList>
#include <QVariantList>
#include <functional>

#include "sample_install/sample_options.h"

namespace zv {

struct SampleTable {
    QString database;  // logical name: OFFICE, MDOCS, BM, ZORVA, MADAD, MAIN, PUB
    QString table;
    QStringList columns;
};

using RowSink = std::function<void(const QVariantList&)>;

class SampleData {
  public:
    explicit SampleData(const SampleOptions& options);

    // Every table that receives rows, with the columns the rows fill, in load order.
    static const QList<SampleTable>& Tables();
    // Calls sink once per row of the table, in insertion order.
    void Rows(const QString& table, const RowSink& sink) const;

    // Sizes of the built-in set.
    static int BaseClientCount();
    static int BaseLookForCount();

  private:
    void ClientRows(const RowSink& sink) const;
    void LookForRows(const RowSink& sink) const;
    void MSqlRows(const RowSink& sink) const;
    void UserRows(const RowSink& sink) const;

    SampleOptions options_;
};

}  // namespace zv
