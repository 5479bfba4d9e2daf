#pragma once
// The columns of a list window's grid and the named layouts of the per-user ".grx" file.
//
// A layout file is UTF-8 JSON holding any number of named layouts; each is the list of the
// grid's columns in display order:
//
//   {"layouts": {"תבנית בסיסית": [
//       {"field": "NUM", "caption": "מספר", "width": 90, "visible": true},
//       {"field": "", "caption": "", "width": 40, "visible": true}, ...]}}
//
// An empty field is the unbound row-number column.

#include <QString>
#include <vector>

namespace zv {

struct GridColumn {
    QString caption;
    QString field;  // empty: the row number
    int width = 100;
    bool visible = true;

    bool operator==(const GridColumn&) const = default;
};
using GridColumns = std::vector<GridColumn>;

// The name under which the windows keep their layout.
QString BasicLayoutName();

// The built-in column sets of the client list and of the name and case list.
GridColumns ClientColumns();
GridColumns NamesColumns();

// Reads the named layout. Throws VbError when the file cannot be read, is not a layout
// file, or holds no layout of that name.
GridColumns LoadLayout(const QString& file, const QString& name);
// Adds the layout to the file under the name, replacing a layout of that name and keeping
// the others. Throws VbError when the file cannot be written.
void SaveLayout(const QString& file, const QString& name, const GridColumns& columns);

}  // namespace zv
