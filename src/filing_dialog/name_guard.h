#pragma once
// Keeps the characters that may not appear in a file name out of a text box, however they
// arrive: typed, pasted or dropped. A refused input shows one message and leaves the text
// as it was.

#include <QObject>
#include <QString>

class QLineEdit;

namespace zv {

class NameGuard : public QObject {
    Q_OBJECT

  public:
    // Watches edit for its whole life; the guard is owned by the edit.
    explicit NameGuard(QLineEdit* edit);

  protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

  private:
    void OnTextChanged(const QString& text);
    void OnTextEdited(const QString& text);
    void OnCursorMoved(int oldPos, int newPos);

    QLineEdit* edit_;
    QString accepted_;
    int acceptedCursor_ = 0;
};

}  // namespace zv
