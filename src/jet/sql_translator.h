#pragma once

#include <QHash>
#include <QList>
#include <QString>
#include <QStringList>
#include <QVariant>
#include <functional>

// The component writes its SQL in the engine dialect of its original platform: True/False,
// Format$, Val, Date(), Like with * and ?, + joining texts, double-quoted text literals,
// [bracketed] names, "DELETE * FROM" and outer-join updates that add the rows they miss.
// The translator turns that dialect into SQLite SQL. It works on tokens and a small
// expression parser, so literals and names are never mistaken for each other.
namespace etq::jet::sql {

struct Token {
    enum Kind { Identifier, Bracketed, String, Number, DateLiteral, Symbol, End };
    Kind kind = End;
    QString text;   // as written
    QString value;  // names and texts decoded: [a b] -> a b, 'it''s' -> it's
    double number = 0;
    qsizetype pos = 0;

    bool is(const char* word) const;  // a keyword or symbol, case-insensitive
};

// Splits a statement into tokens. Throws JetError for an unterminated text or name.
QList<Token> tokenize(const QString& sql);

struct SourceTable {
    QString name;   // the table as named in FROM
    QString alias;  // the name the statement uses for it (the name itself when none)
};

// A value the caller binds to ?N: a literal taken out of the text, or the value of a field.
struct Parameter {
    QVariant literal;
    int field = -1;  // >= 0: index of the field whose value is bound
};

struct Translation {
    enum Kind { Select, Insert, Update, Delete, Other };
    Kind kind = Other;
    QString sql;
    // SELECT with Options::addRowids: the tables whose rowids end the select list, in order.
    // Empty when the rows cannot be traced back to table rows (grouping, DISTINCT, UNION).
    QList<SourceTable> rowidTables;
    QList<Parameter> parameters;  // in ?1, ?2, ... order
};

struct Options {
    // INSERT and UPDATE skip the rows that break a key or a field rule instead of failing the
    // statement, as the engine's Execute does when it is not asked to fail on errors.
    bool ignoreRowErrors = false;
    // SELECT: append the rowid of every table of the outer FROM, so that rows can be updated.
    bool addRowids = false;
    // Criteria: literals become parameters (one prepared statement serves every value).
    bool parameterizeLiterals = false;
    // Criteria: names of these fields (lower case -> index) become parameters.
    const QHash<QString, int>* fieldParameters = nullptr;
    // The primary key fields of a table, for outer-join updates.
    std::function<QStringList(const QString& table)> primaryKey;
};

// Translates one statement. Throws JetError (3075) for text it cannot read.
Translation translate(const QString& jetSql, const Options& options = {});

// Translates a criterion (the text after WHERE), as FindFirst takes it.
Translation translateCriterion(const QString& criterion, const Options& options = {});

// The criterion with its literals taken out, and the literals in order: criteria that differ
// only in their literals have one shape, and translateCriterion with parameterizeLiterals
// gives them the same text with the literals as ?1, ?2, ...
QString criterionShape(const QString& criterion, QList<QVariant>* literals);

// The name the SQLite side gives an identifier: double-quoted, inner quotes doubled.
QString quoteName(const QString& name);
// A text literal for SQLite: single-quoted, inner apostrophes doubled.
QString quoteText(const QString& text);

}  // namespace etq::jet::sql
