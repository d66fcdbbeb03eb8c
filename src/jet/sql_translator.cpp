#include "jet/sql_translator.h"

#include <QSet>

#include "jet/error.h"
#include "jet/vb.h"

namespace etq::jet::sql {

bool Token::is(const char* word) const {
    if (kind != Identifier && kind != Symbol) return false;
    return text.compare(QLatin1String(word), Qt::CaseInsensitive) == 0;
}

QString quoteName(const QString& name) {
    QString quoted = name;
    quoted.replace(u'"', QLatin1String("\"\""));
    return u'"' + quoted + u'"';
}

QString quoteText(const QString& text) {
    QString quoted = text;
    quoted.replace(u'\'', QLatin1String("''"));
    return u'\'' + quoted + u'\'';
}

namespace {

[[noreturn]] void syntaxError(const QString& what, const QString& sql) {
    fail(err::kSyntax, QString("Syntax error in query expression: %1 in '%2'.").arg(what, sql));
}

bool isNameStart(QChar c) {
    return c.isLetter() || c == u'_';
}
bool isNameChar(QChar c) {
    return c.isLetterOrNumber() || c == u'_' || c == u'$';
}

// The text literal that opens at `start` (with ' or "; a doubled quote stands for itself):
// its value, and the position after its closing quote, or -1 when it does not close.
qsizetype readQuoted(const QString& text, qsizetype start, QString* value) {
    const QChar quote = text[start];
    value->clear();
    for (qsizetype j = start + 1; j < text.size(); ++j) {
        if (text[j] != quote) {
            *value += text[j];
        } else if (j + 1 < text.size() && text[j + 1] == quote) {
            *value += quote;
            ++j;
        } else {
            return j + 1;
        }
    }
    return -1;
}

// #m/d/yyyy# or #yyyy-mm-dd# [time], as the engine reads date literals.
double parseDateLiteral(const QString& text, const QString& sql) {
    const QString t = text.trimmed();
    QDateTime dt;
    for (const char* f : {"M/d/yyyy", "M/d/yyyy H:mm:ss", "M/d/yyyy H:mm", "yyyy-MM-dd",
                          "yyyy-MM-dd H:mm:ss", "yyyy-MM-dd H:mm"}) {
        dt = QDateTime::fromString(t, QString::fromLatin1(f));
        if (dt.isValid()) return vb::toSerial(dt);
    }
    syntaxError(QString("date #%1#").arg(text), sql);
}

}  // namespace

QList<Token> tokenize(const QString& sql) {
    QList<Token> tokens;
    const qsizetype n = sql.size();
    qsizetype i = 0;
    while (i < n) {
        const QChar c = sql[i];
        if (c.isSpace()) {
            ++i;
            continue;
        }
        Token t;
        t.pos = i;
        if (isNameStart(c)) {
            qsizetype j = i + 1;
            while (j < n && isNameChar(sql[j]))
                ++j;
            t.kind = Token::Identifier;
            t.text = t.value = sql.mid(i, j - i);
            i = j;
        } else if (c.isDigit() || (c == u'.' && i + 1 < n && sql[i + 1].isDigit())) {
            qsizetype j = i;
            while (j < n && sql[j].isDigit())
                ++j;
            if (j < n && sql[j] == u'.') {
                ++j;
                while (j < n && sql[j].isDigit())
                    ++j;
            }
            if (j < n && (sql[j] == u'e' || sql[j] == u'E')) {
                qsizetype k = j + 1;
                if (k < n && (sql[k] == u'+' || sql[k] == u'-')) ++k;
                if (k < n && sql[k].isDigit()) {
                    while (k < n && sql[k].isDigit())
                        ++k;
                    j = k;
                }
            }
            t.kind = Token::Number;
            t.text = sql.mid(i, j - i);
            t.number = t.text.toDouble();
            i = j;
        } else if (c == u'\'' || c == u'"') {
            const qsizetype end = readQuoted(sql, i, &t.value);
            if (end < 0) syntaxError("missing closing quote", sql);
            t.kind = Token::String;
            t.text = sql.mid(i, end - i);
            i = end;
        } else if (c == u'[') {
            const qsizetype j = sql.indexOf(u']', i + 1);
            if (j < 0) syntaxError("missing ]", sql);
            t.kind = Token::Bracketed;
            t.text = sql.mid(i, j + 1 - i);
            t.value = sql.mid(i + 1, j - i - 1);
            i = j + 1;
        } else if (c == u'#') {
            const qsizetype j = sql.indexOf(u'#', i + 1);
            if (j < 0) syntaxError("missing closing #", sql);
            t.kind = Token::DateLiteral;
            t.text = sql.mid(i, j + 1 - i);
            t.value = sql.mid(i + 1, j - i - 1);
            t.number = parseDateLiteral(t.value, sql);
            i = j + 1;
        } else {
            static const QStringList twoChar = {"<=", ">=", "<>", "!="};
            const QString pair = sql.mid(i, 2);
            t.kind = Token::Symbol;
            if (twoChar.contains(pair)) {
                t.text = pair == "!=" ? "<>" : pair;
                i += 2;
            } else {
                t.text = QString(c);
                ++i;
            }
            t.value = t.text;
        }
        tokens.append(t);
    }
    Token end;
    end.kind = Token::End;
    end.pos = n;
    tokens.append(end);
    return tokens;
}

namespace {

// How each function of the dialect is written for SQLite: a function of ours, a built-in, or a
// template over the arguments (%1, %2, ...).
struct FunctionRule {
    const char* jet;
    const char* sqlite;
    bool isTemplate = false;
};

constexpr FunctionRule kFunctions[] = {
    {"format", "jet_format"},
    {"format$", "jet_format"},
    {"val", "jet_val"},
    {"date", "jet_date"},
    {"date$", "jet_date"},
    {"now", "jet_now"},
    {"time", "jet_time"},
    {"time$", "jet_time"},
    {"len", "length"},
    {"left", "jet_left"},
    {"left$", "jet_left"},
    {"right", "jet_right"},
    {"right$", "jet_right"},
    {"mid", "jet_mid"},
    {"mid$", "jet_mid"},
    {"trim", "jet_trim"},
    {"trim$", "jet_trim"},
    {"ltrim", "jet_ltrim"},
    {"ltrim$", "jet_ltrim"},
    {"rtrim", "jet_rtrim"},
    {"rtrim$", "jet_rtrim"},
    {"ucase", "upper"},
    {"ucase$", "upper"},
    {"lcase", "lower"},
    {"lcase$", "lower"},
    {"nz", "jet_nz"},
    {"cint", "jet_cint"},
    {"clng", "jet_clng"},
    {"cdbl", "jet_cdbl"},
    {"csng", "jet_cdbl"},
    {"cstr", "jet_cstr"},
    {"str", "jet_str"},
    {"str$", "jet_str"},
    {"int", "jet_int"},
    {"fix", "jet_fix"},
    {"abs", "abs"},
    {"sgn", "jet_sgn"},
    {"instr", "jet_instr"},
    {"year", "jet_year"},
    {"month", "jet_month"},
    {"day", "jet_day"},
    {"weekday", "jet_weekday"},
    {"hour", "jet_hour"},
    {"minute", "jet_minute"},
    {"second", "jet_second"},
    {"dateserial", "jet_dateserial"},
    {"cdate", "jet_cdate"},
    {"datevalue", "jet_cdate"},
    {"iif", "(CASE WHEN %1 THEN %2 ELSE %3 END)", true},
    {"isnull", "(CASE WHEN %1 IS NULL THEN -1 ELSE 0 END)", true},
    {"cbool", "(CASE WHEN %1 THEN -1 ELSE 0 END)", true},
    {"count", "count"},
    {"sum", "sum"},
    {"avg", "avg"},
    {"min", "min"},
    {"max", "max"},
};

const FunctionRule* findFunction(const QString& name) {
    for (const FunctionRule& f : kFunctions)
        if (name.compare(QLatin1String(f.jet), Qt::CaseInsensitive) == 0) return &f;
    return nullptr;
}

bool isAggregate(const QString& name) {
    static const QSet<QString> names = {"count", "sum",   "avg",    "min", "max", "first",
                                        "last",  "stdev", "stdevp", "var", "varp"};
    return names.contains(name.toLower());
}

// Words that end an expression or a select item, so they are never taken for an alias.
bool isClauseWord(const Token& t) {
    static const QSet<QString> words = {
        "select", "from", "where", "group",   "having", "order",    "union",       "inner", "left",
        "right",  "full", "outer", "join",    "on",     "as",       "set",         "and",   "or",
        "not",    "asc",  "desc",  "by",      "into",   "values",   "cross",       "limit", "xor",
        "like",   "is",   "in",    "between", "mod",    "distinct", "distinctrow", "top"};
    return t.kind == Token::Identifier && words.contains(t.text.toLower());
}

enum Precedence {
    kOr = 1,
    kAnd = 2,
    kNot = 3,
    kCompare = 4,
    kConcat = 5,
    kAdd = 6,
    kMod = 7,
    kIntDiv = 8,
    kMul = 9,
    kUnary = 10,
    kPower = 11,
};

class Parser {
  public:
    Parser(const QString& sql, const Options& options) : sql_(sql), options_(options) {
        tokens_ = tokenize(sql);
        // A statement may end with a semicolon.
        if (tokens_.size() >= 2 && tokens_[tokens_.size() - 2].is(";"))
            tokens_.remove(tokens_.size() - 2);
    }

    Translation statement() {
        Translation t;
        const Token& first = peek();
        if (first.is("select")) {
            t.kind = Translation::Select;
            t.sql = select(0);
            t.rowidTables = rowidTables_;
        } else if (first.is("insert")) {
            t.kind = Translation::Insert;
            t.sql = insert();
        } else if (first.is("update")) {
            t.kind = Translation::Update;
            t.sql = update();
        } else if (first.is("delete")) {
            t.kind = Translation::Delete;
            t.sql = remove();
        } else {
            t.kind = Translation::Other;
            t.sql = passThrough();
        }
        expectEnd();
        t.parameters = parameters_;
        return t;
    }

    Translation criterion() {
        Translation t;
        t.sql = expression(0);
        expectEnd();
        t.parameters = parameters_;
        return t;
    }

  private:
    // --- token access -------------------------------------------------------------------
    const Token& peek(int ahead = 0) const {
        const qsizetype i = std::min<qsizetype>(pos_ + ahead, tokens_.size() - 1);
        return tokens_[i];
    }
    const Token& next() {
        const Token& t = tokens_[pos_];
        if (pos_ < tokens_.size() - 1) ++pos_;
        return t;
    }
    bool accept(const char* word) {
        if (!peek().is(word)) return false;
        next();
        return true;
    }
    void expect(const char* word) {
        if (!accept(word)) unexpected(QString("'%1' expected").arg(word));
    }
    void expectEnd() {
        if (peek().kind != Token::End) unexpected("end of statement expected");
    }
    [[noreturn]] void unexpected(const QString& what) const {
        const Token& t = peek();
        const QString near =
            t.kind == Token::End ? QString("the end") : QString("'%1'").arg(t.text);
        syntaxError(QString("%1, found %2").arg(what, near), sql_);
    }

    bool atName() const {
        const Token& t = peek();
        return (t.kind == Token::Identifier && !isClauseWord(t)) || t.kind == Token::Bracketed;
    }
    QString takeName() {
        if (!atName()) unexpected("a name expected");
        return next().value;
    }

    // --- statements ---------------------------------------------------------------------
    QString select(int depth) {
        expect("select");
        QString head = "SELECT";
        bool traceable = depth == 0;
        if (accept("distinct")) {
            head += " DISTINCT";
            traceable = false;
        } else {
            accept("distinctrow") || accept("all");  // both mean the plain SELECT here
        }
        QString limit;
        if (accept("top")) {
            if (peek().kind != Token::Number) unexpected("a number after TOP");
            limit = " LIMIT " + next().text;
            if (peek().is("percent")) unexpected("TOP ... PERCENT is not supported");
        }
        const bool savedAggregate = aggregateSeen_;
        aggregateSeen_ = false;
        QStringList items;
        do {
            items << selectItem(items.size());
        } while (accept(","));
        QString rest;
        QList<SourceTable> tables;
        if (accept("from")) rest += " FROM " + tableList(depth == 0 ? &tables : nullptr);
        if (accept("where")) rest += " WHERE " + expression(0);
        if (peek().is("group")) {
            next();
            expect("by");
            rest += " GROUP BY " + expressionList();
            traceable = false;
        }
        if (accept("having")) rest += " HAVING " + expression(0);
        QString order;
        if (peek().is("order")) {
            next();
            expect("by");
            QStringList keys;
            do {
                QString key = expression(0);
                if (accept("asc"))
                    key += " ASC";
                else if (accept("desc"))
                    key += " DESC";
                keys << key;
            } while (accept(","));
            order = " ORDER BY " + keys.join(", ");
        }
        if (peek().is("union")) {
            next();
            rest += accept("all") ? " UNION ALL " : " UNION ";
            rest += select(depth + 1);
            traceable = false;
        }
        if (aggregateSeen_) traceable = false;
        aggregateSeen_ = savedAggregate;

        if (depth == 0 && options_.addRowids && traceable && !tables.isEmpty()) {
            // The rowid of each table goes last, so the visible columns keep their positions.
            for (int i = 0; i < tables.size(); ++i)
                items << QString("%1.rowid AS %2")
                             .arg(quoteName(tables[i].alias),
                                  quoteName(QString("__rowid%1").arg(i)));
            rowidTables_ = tables;
        }
        return head + " " + items.join(", ") + rest + order + limit;
    }

    QString selectItem(qsizetype index) {
        if (peek().is("*")) {
            next();
            return "*";
        }
        // table.* stays a star.
        if ((peek().kind == Token::Identifier || peek().kind == Token::Bracketed) &&
            peek(1).is(".") && peek(2).is("*")) {
            const QString table = next().value;
            next();
            next();
            return quoteName(table) + ".*";
        }
        const qsizetype start = pos_;
        const QString expr = expression(0);
        const bool plainColumn = isPlainName(start, pos_);
        QString alias;
        if (accept("as"))
            alias = takeName();
        else if (atName())
            alias = takeName();
        if (!alias.isEmpty()) return expr + " AS " + quoteName(alias);
        // An unnamed expression is named the way the engine names it: Expr1000 + position.
        if (!plainColumn) return expr + " AS " + quoteName(QString("Expr%1").arg(1000 + index));
        return expr;
    }

    bool isPlainName(qsizetype from, qsizetype to) const {
        for (qsizetype i = from; i < to; ++i) {
            const Token& t = tokens_[i];
            const bool name = t.kind == Token::Identifier || t.kind == Token::Bracketed;
            const bool dot = t.is(".");
            if ((i - from) % 2 == 0 ? !name : !dot) return false;
        }
        return to > from;
    }

    QString tableList(QList<SourceTable>* tables) {
        QString out = joinedTables(tables);
        while (accept(","))
            out += ", " + joinedTables(tables);
        return out;
    }

    QString joinedTables(QList<SourceTable>* tables) {
        QString out = tablePrimary(tables);
        for (;;) {
            QString join;
            if (peek().is("inner")) {
                next();
                join = "INNER JOIN";
            } else if (peek().is("left") || peek().is("right")) {
                join = next().text.toUpper();
                accept("outer");
                join += " JOIN";
            } else if (peek().is("cross")) {
                next();
                join = "CROSS JOIN";
            } else if (peek().is("join")) {
                join = "JOIN";
                // "JOIN" alone is taken below.
            } else {
                break;
            }
            expect("join");
            out += " " + join + " " + tablePrimary(tables);
            if (accept("on")) out += " ON " + expression(0);
        }
        return out;
    }

    QString tablePrimary(QList<SourceTable>* tables) {
        if (peek().is("(")) {
            next();
            QString inner;
            if (peek().is("select")) {
                inner = "(" + select(1) + ")";
                expect(")");
                return inner + tableAlias(nullptr);
            }
            inner = "(" + tableList(tables) + ")";
            expect(")");
            return inner;
        }
        const QString name = takeName();
        SourceTable source{name, name};
        QString out = quoteName(name);
        const QString alias = tableAlias(&source);
        if (tables) tables->append(source);
        return out + alias;
    }

    QString tableAlias(SourceTable* source) {
        QString alias;
        if (accept("as"))
            alias = takeName();
        else if (atName())
            alias = takeName();
        if (alias.isEmpty()) return {};
        if (source) source->alias = alias;
        return " AS " + quoteName(alias);
    }

    QString insertHead() {
        return options_.ignoreRowErrors ? "INSERT OR IGNORE INTO " : "INSERT INTO ";
    }

    QString insert() {
        expect("insert");
        expect("into");
        QString out = insertHead() + quoteName(takeName());
        if (peek().is("(") && !peek(1).is("select")) {
            next();
            QStringList columns;
            do {
                columns << quoteName(takeName());
            } while (accept(","));
            expect(")");
            out += " (" + columns.join(", ") + ")";
        }
        if (accept("values")) {
            QStringList rowsText;
            do {
                expect("(");
                rowsText << "(" + expressionList() + ")";
                expect(")");
            } while (accept(","));
            return out + " VALUES " + rowsText.join(", ");
        }
        if (peek().is("(")) {
            next();
            out += " " + select(1);
            expect(")");
            return out;
        }
        return out + " " + select(1);
    }

    QString remove() {
        expect("delete");
        // DELETE * FROM t, DELETE t.* FROM t and DELETE t FROM t all empty t.
        if (!peek().is("from")) {
            while (!peek().is("from") && peek().kind != Token::End)
                next();
        }
        expect("from");
        QString out = "DELETE FROM " + quoteName(takeName());
        if (accept("where")) out += " WHERE " + expression(0);
        return out;
    }

    struct Assignment {
        QString qualifier;  // the table the target field names, if it names one
        QString column;
        QString value;
    };

    QList<Assignment> assignments() {
        QList<Assignment> list;
        do {
            Assignment a;
            QString name = takeName();
            if (accept(".")) {
                a.qualifier = name;
                name = takeName();
            }
            a.column = name;
            expect("=");
            a.value = expression(0);
            list.append(a);
        } while (accept(","));
        return list;
    }

    QString update() {
        expect("update");
        const QString updateHead = options_.ignoreRowErrors ? "UPDATE OR IGNORE " : "UPDATE ";
        SourceTable first{takeName(), {}};
        first.alias = first.name;
        tableAlias(&first);
        QString joinKind;
        if (peek().is("left") || peek().is("right") || peek().is("inner")) {
            joinKind = next().text.toLower();
            accept("outer");
            expect("join");
        }
        if (joinKind.isEmpty()) {
            expect("set");
            QStringList sets;
            for (const Assignment& a : assignments())
                sets << quoteName(a.column) + " = " + a.value;
            QString out =
                updateHead + quoteName(first.name) + aliasText(first) + " SET " + sets.join(", ");
            if (accept("where")) out += " WHERE " + expression(0);
            return out;
        }
        SourceTable second{takeName(), {}};
        second.alias = second.name;
        tableAlias(&second);
        expect("on");
        const QString on = expression(0);
        expect("set");
        qualifiersSeen_.clear();
        const QList<Assignment> sets = assignments();
        QString where;
        if (accept("where")) where = expression(0);
        if (joinKind == "inner") return innerJoinUpdate(updateHead, first, second, on, sets, where);
        // An outer-join update writes the table on the outer side: it updates the rows that
        // match and adds the rows that are missing.
        const SourceTable& source = joinKind == "left" ? first : second;
        const SourceTable& target = joinKind == "left" ? second : first;
        return outerJoinUpdate(source, target, sets, where);
    }

    static QString aliasText(const SourceTable& t) {
        return t.alias.compare(t.name, Qt::CaseInsensitive) == 0 ? QString()
                                                                 : " AS " + quoteName(t.alias);
    }

    static bool names(const SourceTable& t, const QString& qualifier) {
        return qualifier.isEmpty() || t.alias.compare(qualifier, Qt::CaseInsensitive) == 0 ||
               t.name.compare(qualifier, Qt::CaseInsensitive) == 0;
    }

    QString outerJoinUpdate(const SourceTable& source, const SourceTable& target,
                            const QList<Assignment>& sets, const QString& where) {
        for (const QString& q : qualifiersSeen_) {
            if (names(target, q) && !q.isEmpty())
                unexpected(
                    QString("an outer-join update whose values read the table it writes (%1)")
                        .arg(target.name));
        }
        QStringList columns, values, updates;
        for (const Assignment& a : sets) {
            if (!names(target, a.qualifier))
                unexpected(QString("an outer-join update that writes %1 instead of %2")
                               .arg(a.qualifier, target.name));
            columns << quoteName(a.column);
            values << a.value;
            updates << quoteName(a.column) + " = excluded." + quoteName(a.column);
        }
        const QStringList key =
            options_.primaryKey ? options_.primaryKey(target.name) : QStringList();
        if (key.isEmpty())
            fail(err::kSyntax, QString("The outer-join update needs a primary key on table '%1'.")
                                   .arg(target.name));
        QStringList keyColumns;
        for (const QString& k : key)
            keyColumns << quoteName(k);
        // "WHERE 1" keeps SQLite from reading ON CONFLICT as a join constraint.
        QString out = insertHead() + quoteName(target.name) + " (" + columns.join(", ") +
                      ") SELECT " + values.join(", ") + " FROM " + quoteName(source.name) +
                      aliasText(source) + " WHERE 1";
        if (!where.isEmpty()) out += " AND (" + where + ")";
        out += " ON CONFLICT (" + keyColumns.join(", ") + ") DO UPDATE SET " + updates.join(", ");
        return out;
    }

    QString innerJoinUpdate(const QString& head, const SourceTable& first,
                            const SourceTable& second, const QString& on,
                            const QList<Assignment>& sets, const QString& where) {
        // The table the assignments name is updated; the other one gives values.
        const bool writesSecond = !sets.isEmpty() && !sets.first().qualifier.isEmpty() &&
                                  names(second, sets.first().qualifier) &&
                                  !names(first, sets.first().qualifier);
        const SourceTable& target = writesSecond ? second : first;
        const SourceTable& other = writesSecond ? first : second;
        QStringList list;
        for (const Assignment& a : sets) {
            if (!names(target, a.qualifier)) unexpected("a joined update that writes two tables");
            list << quoteName(a.column) + " = " + a.value;
        }
        QString out = head + quoteName(target.name) + aliasText(target) + " SET " +
                      list.join(", ") + " FROM " + quoteName(other.name) + aliasText(other) +
                      " WHERE (" + on + ")";
        if (!where.isEmpty()) out += " AND (" + where + ")";
        return out;
    }

    // Statements the component does not compose (DDL and the like) keep their words; only
    // texts, names and True/False are put into SQLite's form.
    QString passThrough() {
        QStringList out;
        while (peek().kind != Token::End) {
            const Token& t = next();
            switch (t.kind) {
                case Token::String:
                    out << quoteText(t.value);
                    break;
                case Token::Bracketed:
                    out << quoteName(t.value);
                    break;
                case Token::DateLiteral:
                    out << QString::number(t.number, 'g', 17);
                    break;
                case Token::Identifier:
                    if (t.is("true"))
                        out << "-1";
                    else if (t.is("false"))
                        out << "0";
                    else
                        out << t.text;
                    break;
                default:
                    out << t.text;
                    break;
            }
        }
        return out.join(u' ');
    }

    // --- expressions --------------------------------------------------------------------
    QString expressionList() {
        QStringList list;
        do {
            list << expression(0);
        } while (accept(","));
        return list.join(", ");
    }

    QString parameter(const Parameter& p) {
        parameters_.append(p);
        return QString("?%1").arg(parameters_.size());
    }

    QString literal(const QVariant& value, const QString& text) {
        if (options_.parameterizeLiterals) return parameter({value, -1});
        return text;
    }

    QString primary() {
        const Token& t = peek();
        switch (t.kind) {
            case Token::String: {
                const Token s = next();
                return literal(s.value, quoteText(s.value));
            }
            case Token::Number: {
                const Token s = next();
                const bool whole =
                    !s.text.contains(u'.') && !s.text.contains(u'e', Qt::CaseInsensitive);
                const QVariant v = whole ? QVariant(s.text.toLongLong()) : QVariant(s.number);
                return literal(v, s.text);
            }
            case Token::DateLiteral: {
                const Token s = next();
                return literal(s.number, QString::number(s.number, 'g', 17));
            }
            case Token::Symbol:
                if (t.is("(")) {
                    next();
                    QString inner;
                    if (peek().is("select"))
                        inner = select(1);
                    else
                        inner = expression(0);
                    expect(")");
                    return "(" + inner + ")";
                }
                if (t.is("-")) {
                    next();
                    return "(-" + expression(kUnary) + ")";
                }
                if (t.is("+")) {
                    next();
                    return expression(kUnary);
                }
                unexpected("a value expected");
            case Token::Identifier:
                if (t.is("true") || t.is("false")) return next().is("true") ? "-1" : "0";
                if (t.is("null")) {
                    next();
                    return "NULL";
                }
                if (t.is("not")) {
                    next();
                    return "(NOT " + expression(kNot) + ")";
                }
                if (t.is("exists")) {
                    next();
                    expect("(");
                    const QString sub = select(1);
                    expect(")");
                    return "EXISTS (" + sub + ")";
                }
                if (isClauseWord(t)) unexpected("a value expected");
                if (peek(1).is("(")) return functionCall();
                return name();
            case Token::Bracketed:
                return name();
            case Token::End:
                unexpected("a value expected");
        }
        unexpected("a value expected");
    }

    QString name() {
        QStringList parts;
        parts << next().value;
        while (peek().is(".") || peek().is("!")) {
            next();
            parts << takeName();
        }
        if (parts.size() > 1)
            qualifiersSeen_.insert(parts[parts.size() - 2]);
        else
            qualifiersSeen_.insert(QString());
        if (options_.fieldParameters) {
            const auto it = options_.fieldParameters->find(parts.last().toLower());
            // Texts of the engine compare without regard to case.
            if (it != options_.fieldParameters->end())
                return "(" + parameter({{}, it.value()}) + " COLLATE NOCASE)";
        }
        QStringList quoted;
        for (const QString& p : parts)
            quoted << quoteName(p);
        return quoted.join(u'.');
    }

    QString functionCall() {
        const QString jetName = next().text;
        expect("(");
        QStringList args;
        if (!peek().is(")")) {
            do {
                if (peek().is("*")) {
                    next();
                    args << "*";
                } else {
                    args << expression(0);
                }
            } while (accept(","));
        }
        expect(")");
        if (isAggregate(jetName)) aggregateSeen_ = true;
        const FunctionRule* rule = findFunction(jetName);
        if (!rule) return jetName + "(" + args.join(", ") + ")";
        if (!rule->isTemplate)
            return QString::fromLatin1(rule->sqlite) + "(" + args.join(", ") + ")";
        QString out = QString::fromLatin1(rule->sqlite);
        for (qsizetype i = 0; i < args.size(); ++i)
            out.replace(QString("%%1").arg(i + 1), args[i]);
        if (out.contains(u'%')) unexpected(QString("more arguments for %1").arg(jetName));
        return out;
    }

    static int infixPrecedence(const Token& t) {
        if (t.is("or") || t.is("xor")) return kOr;
        if (t.is("and")) return kAnd;
        if (t.is("=") || t.is("<>") || t.is("<") || t.is(">") || t.is("<=") || t.is(">=") ||
            t.is("like") || t.is("is") || t.is("between") || t.is("in") || t.is("not"))
            return kCompare;
        if (t.is("&")) return kConcat;
        if (t.is("+") || t.is("-")) return kAdd;
        if (t.is("mod")) return kMod;
        if (t.is("\\")) return kIntDiv;
        if (t.is("*") || t.is("/")) return kMul;
        if (t.is("^")) return kPower;
        return 0;
    }

    QString expression(int minPrecedence) {
        QString left = primary();
        for (;;) {
            const Token& op = peek();
            const int prec = infixPrecedence(op);
            if (prec == 0 || prec < minPrecedence) break;
            // "Not" between operands belongs to Like, In and Between.
            if (op.is("not") && !(peek(1).is("like") || peek(1).is("in") || peek(1).is("between")))
                break;
            next();
            left = infix(op, left, prec);
        }
        return left;
    }

    QString infix(const Token& op, const QString& left, int prec) {
        if (op.is("or")) return "(" + left + " OR " + expression(prec + 1) + ")";
        if (op.is("xor")) return "((" + left + " <> 0) <> (" + expression(prec + 1) + " <> 0))";
        if (op.is("and")) return "(" + left + " AND " + expression(prec + 1) + ")";
        if (op.is("is")) {
            const bool negated = accept("not");
            expect("null");
            return "(" + left + (negated ? " IS NOT NULL)" : " IS NULL)");
        }
        bool negated = false;
        Token actual = op;
        if (op.is("not")) {
            negated = true;
            actual = next();
        }
        const QString notWord = negated ? "NOT " : "";
        if (actual.is("like"))
            return "(" + notWord + "jet_like(" + left + ", " + expression(prec + 1) + "))";
        if (actual.is("between")) {
            const QString low = expression(kConcat);
            expect("and");
            const QString high = expression(kConcat);
            return "(" + left + " " + notWord + "BETWEEN " + low + " AND " + high + ")";
        }
        if (actual.is("in")) {
            expect("(");
            const QString list = peek().is("select") ? select(1) : expressionList();
            expect(")");
            return "(" + left + " " + notWord + "IN (" + list + "))";
        }
        const QString right = expression(op.is("^") ? prec : prec + 1);
        if (op.is("&")) return "jet_concat(" + left + ", " + right + ")";
        if (op.is("+")) return "jet_add(" + left + ", " + right + ")";
        if (op.is("/")) return "jet_div(" + left + ", " + right + ")";
        if (op.is("\\")) return "jet_idiv(" + left + ", " + right + ")";
        if (op.is("mod")) return "jet_mod(" + left + ", " + right + ")";
        if (op.is("^")) return "jet_pow(" + left + ", " + right + ")";
        return "(" + left + " " + op.text + " " + right + ")";
    }

    QString sql_;
    Options options_;
    QList<Token> tokens_;
    qsizetype pos_ = 0;
    bool aggregateSeen_ = false;
    QList<SourceTable> rowidTables_;
    QList<Parameter> parameters_;
    QSet<QString> qualifiersSeen_;
};

}  // namespace

QString criterionShape(const QString& criterion, QList<QVariant>* literals) {
    QString shape;
    shape.reserve(criterion.size());
    const qsizetype n = criterion.size();
    for (qsizetype i = 0; i < n;) {
        const QChar c = criterion[i];
        if (isNameStart(c) || c == u'[') {
            // Names (digits inside them too) belong to the shape.
            const qsizetype j = c == u'[' ? std::max(criterion.indexOf(u']', i), i) + 1 : i + 1;
            qsizetype k = j;
            if (c != u'[')
                while (k < n && isNameChar(criterion[k]))
                    ++k;
            shape += QStringView(criterion).mid(i, k - i);
            i = k;
        } else if (c == u'\'' || c == u'"') {
            QString value;
            const qsizetype end = readQuoted(criterion, i, &value);
            literals->append(value);
            shape += u'\x01';
            i = end < 0 ? n : end;
        } else if (c.isDigit() || (c == u'.' && i + 1 < n && criterion[i + 1].isDigit()) ||
                   c == u'#') {
            // Numbers and dates: let the tokenizer read exactly one token here.
            const QList<Token> one = tokenize(criterion.mid(i));
            const Token& t = one.first();
            if (t.kind == Token::Number) {
                const bool whole =
                    !t.text.contains(u'.') && !t.text.contains(u'e', Qt::CaseInsensitive);
                literals->append(whole ? QVariant(t.text.toLongLong()) : QVariant(t.number));
            } else {
                literals->append(t.number);
            }
            shape += u'\x02';
            i += t.text.size();
        } else {
            shape += c;
            ++i;
        }
    }
    return shape;
}

Translation translate(const QString& jetSql, const Options& options) {
    Parser parser(jetSql, options);
    return parser.statement();
}

Translation translateCriterion(const QString& criterion, const Options& options) {
    Parser parser(criterion, options);
    return parser.criterion();
}

}  // namespace etq::jet::sql
