// SPDX-License-Identifier: MIT
#pragma once

#include <QDialog>
#include <QFile>
#include <QJsonObject>
#include <QLineEdit>
#include <QMainWindow>
#include <QMap>

/// A stand-in for the program that a bank gave its customers: real windows that are worked by keys
/// alone, and that write down each transfer they were given.
namespace terminal {

/// What it does to whoever works it. Times are milliseconds, rows are counted from 1, 0 is never.
struct Manners {
    int loginAfter = 0;    ///< the operator logs in so long after the window for it has come
    int modulesAfter = 0;  ///< modules take so long to open
    int late = 0;          ///< so do all other windows
    int slow = 0;          ///< each key is answered so late
    int loseWindowAt = 0;  ///< the module's window goes in the middle of that row, once
    int stealFocusAt = 0;  ///< a notice comes in front in the middle of that row, once
    QString record;        ///< file for the transfers, one in a line
};

class Module;

/// The whole program: shows a window when its time has come, and keeps the record.
class Terminal : public QObject {
public:
    explicit Terminal(const Manners& manners);

    const Manners& manners() const { return manners_; }
    void show(QWidget* window) const { showIn(window, manners_.late); }
    void showIn(QWidget* window, int milliseconds) const;
    void openMain();
    void openModule(const QString& code);
    void write(const QJsonObject& transfer);
    /// A row of a list begins: its beneficiary is being made known.
    void beginRow(Module* module);

protected:
    bool eventFilter(QObject* receiver, QEvent* event) override;

private:
    Manners manners_;
    QFile record_;
    int row_ = 0;
};

/// A module: the list of those who may be paid, and the transfers to them.
class Module : public QMainWindow {
public:
    Module(Terminal& terminal, const QString& title, const QString& maintenance);
    Terminal& terminal() const { return terminal_; }

    QMap<QString, QString> beneficiaries;  ///< names by account

private:
    void openMaintenance();
    void openTransfer();

    Terminal& terminal_;
    QString maintenance_;
};

/// Those who may be paid: one is made known, or taken out again.
class Maintenance : public QDialog {
public:
    Maintenance(Module& module, const QString& title);

private:
    void store();
    void remove();

    Module& module_;
    QLineEdit* account_;
    QLineEdit* name_;
};

/// A transfer, whose fields are looked up with F4.
class Transfer : public QDialog {
public:
    explicit Transfer(Module& module);

private:
    QLineEdit* addField(const QString& name, const QStringList& known);
    void lookUp(QLineEdit* field);
    void store();

    Module& module_;
    QMap<QString, QLineEdit*> fields_;
    QMap<QLineEdit*, QStringList> known_;
};

}  // namespace terminal
