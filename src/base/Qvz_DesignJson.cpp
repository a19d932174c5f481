#include "Qvz_DesignJson.h"

#include <QFile>
#include <QFileInfo>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QJsonParseError>

#include <algorithm>
#include <cerrno>
#include <cmath>
#include <cstddef>
#include <cstring>
#include <deque>
#include <initializer_list>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#ifdef Q_OS_UNIX
#include <fcntl.h>
#include <poll.h>
#include <sys/stat.h>
#include <unistd.h>
#endif

namespace {

constexpr int kMaxBond = 1024;

// Thrown only inside this file, to unwind a validation with its message.
struct LoadError {
    QString message;
};

[[noreturn]] void Fail(const QString& path, const QString& what) {
    throw LoadError{path + ": " + what};
}

// Line and column (1-based) of a byte offset.
std::pair<int, int> LineColumn(const QByteArray& text, qsizetype offset) {
    int line = 1, col = 1;
    for (qsizetype i = 0; i < offset && i < text.size(); ++i) {
        if (text[i] == '\n') {
            ++line;
            col = 1;
        } else {
            ++col;
        }
    }
    return {line, col};
}

// QJsonDocument keeps only one of two equal keys; find such keys first.
// Returns the offset of the earliest second occurrence, or -1. Each object's
// keys are sorted when it closes, in one buffer shared by all objects: no
// allocation per key or object, which big designs would feel.
qsizetype FindDuplicateKey(const QByteArray& text, QString& key) {
    struct Key {
        std::string_view name; // decoded
        qsizetype offset;
    };
    struct Frame {
        bool isObject;
        bool expectKey;
        std::size_t firstKey; // in keys
    };
    std::vector<Frame> stack;
    std::vector<Key> keys;           // the keys of the open objects, innermost last
    std::deque<std::string> decoded; // keys that held escapes
    qsizetype found = -1;
    const auto close = [&]() {
        const Frame f = stack.back();
        stack.pop_back();
        if (!f.isObject)
            return;
        const auto first = keys.begin() + std::ptrdiff_t(f.firstKey);
        std::sort(first, keys.end(), [](const Key& a, const Key& b) {
            return a.name != b.name ? a.name < b.name : a.offset < b.offset;
        });
        for (auto it = first; it != keys.end() && it + 1 != keys.end(); ++it) {
            if (it->name == (it + 1)->name && (found < 0 || (it + 1)->offset < found)) {
                found = (it + 1)->offset;
                key = QString::fromUtf8(it->name.data(), qsizetype(it->name.size()));
            }
        }
        keys.erase(first, keys.end());
    };
    const char* const data = text.constData();
    const qsizetype n = text.size();
    for (qsizetype i = 0; i < n; ++i) {
        const char c = data[i];
        if (c == '{') {
            stack.push_back({true, true, keys.size()});
        } else if (c == '[') {
            stack.push_back({false, false, keys.size()});
        } else if (c == '}' || c == ']') {
            if (!stack.empty())
                close();
        } else if (c == ',') {
            if (!stack.empty() && stack.back().isObject)
                stack.back().expectKey = true;
        } else if (c == '"') {
            const qsizetype start = i;
            bool escaped = false;
            for (++i; i < n && data[i] != '"'; ++i) {
                if (data[i] == '\\' && i + 1 < n) {
                    escaped = true;
                    ++i;
                }
            }
            if (!stack.empty() && stack.back().isObject && stack.back().expectKey) {
                stack.back().expectKey = false;
                std::string_view name(data + start + 1, std::size_t(i - start - 1));
                if (escaped) {
                    // Decode escapes the way the parser will, so "a" and "\u0061" match.
                    const QByteArray raw(name.data(), qsizetype(name.size()));
                    const QJsonDocument d = QJsonDocument::fromJson("[\"" + raw + "\"]");
                    decoded.push_back(
                        (d.isArray() ? d.array().at(0).toString().toUtf8() : raw).toStdString());
                    name = decoded.back();
                }
                keys.push_back({name, start});
            }
        }
    }
    while (!stack.empty())
        close();
    return found;
}

QString Quote(const QString& s) {
    return "\"" + s + "\"";
}

// ------------------------------------------------------------------ readers

void CheckKeys(const QJsonObject& o, const QString& path, std::initializer_list<const char*> known,
               std::initializer_list<const char*> required) {
    for (auto it = o.begin(); it != o.end(); ++it) {
        bool ok = false;
        for (const char* k : known)
            if (it.key() == QLatin1String(k))
                ok = true;
        if (!ok)
            Fail(path, "unknown key " + Quote(it.key()));
    }
    for (const char* k : required)
        if (!o.contains(QLatin1String(k)))
            Fail(path, "missing required key " + Quote(QLatin1String(k)));
}

QJsonObject AsObject(const QJsonValue& v, const QString& path) {
    if (!v.isObject())
        Fail(path, "expected an object");
    return v.toObject();
}

QJsonArray ArrayAt(const QJsonObject& o, const char* key, const QString& path) {
    const QJsonValue v = o.value(QLatin1String(key));
    if (v.isUndefined())
        return {};
    if (!v.isArray())
        Fail(path + "." + key, "expected an array");
    return v.toArray();
}

StringBase StringAt(const QJsonObject& o, const char* key, const QString& path,
                    const StringBase& def = StringBase()) {
    const QJsonValue v = o.value(QLatin1String(key));
    if (v.isUndefined())
        return def;
    if (!v.isString())
        Fail(path + "." + key, "expected a string");
    const QString s = v.toString();
    if (s.contains(QChar(0)))
        Fail(path + "." + key, "a string must not contain NUL characters");
    return StringBase::FromQString(s);
}

bool BoolAt(const QJsonObject& o, const char* key, const QString& path, bool def) {
    const QJsonValue v = o.value(QLatin1String(key));
    if (v.isUndefined())
        return def;
    if (!v.isBool())
        Fail(path + "." + key, "expected true or false");
    return v.toBool();
}

int IntAt(const QJsonObject& o, const char* key, const QString& path, int def, int low, int high) {
    const QJsonValue v = o.value(QLatin1String(key));
    if (v.isUndefined())
        return def;
    const double d = v.toDouble(std::nan(""));
    if (!v.isDouble() || !std::isfinite(d) || std::floor(d) != d || d < low || d > high)
        Fail(path + "." + key,
             QString("expected a whole number from %1 to %2").arg(low).arg(high));
    return static_cast<int>(d);
}

Qvz_StrArray StringsAt(const QJsonObject& o, const char* key, const QString& path) {
    Qvz_StrArray out;
    const QJsonArray a = ArrayAt(o, key, path);
    for (qsizetype i = 0; i < a.size(); ++i) {
        const QString p = QString("%1.%2[%3]").arg(path, key).arg(i);
        if (!a.at(i).isString())
            Fail(p, "expected a string");
        if (a.at(i).toString().contains(QChar(0)))
            Fail(p, "a string must not contain NUL characters");
        out.Add(StringBase::FromQString(a.at(i).toString()));
    }
    return out;
}

// Pin and signal attributes: name and value only, unique names.
void ReadNameValues(const QJsonObject& o, const QString& path, Qvz_NameValueList& out) {
    const QJsonArray a = ArrayAt(o, "attributes", path);
    for (qsizetype i = 0; i < a.size(); ++i) {
        const QString p = QString("%1.attributes[%2]").arg(path).arg(i);
        const QJsonObject ao = AsObject(a.at(i), p);
        CheckKeys(ao, p, {"name", "value"}, {"name", "value"});
        const StringBase name = StringAt(ao, "name", p);
        if (out.Has(name))
            Fail(p + ".name", "duplicate attribute name " + Quote(name.ToQString()));
        out.Items().push_back({name, StringAt(ao, "value", p)});
    }
}

void ReadTarget(const QJsonObject& root, Qvz_Target& t) {
    const QJsonValue tv = root.value("target");
    if (tv.isUndefined())
        return;
    const QString path = "$.target";
    const QJsonObject o = AsObject(tv, path);
    CheckKeys(o, path, {"families", "max_bond", "file_name"}, {});
    const Qvz_StrArray fams = StringsAt(o, "families", path);
    for (int i = 0; i < fams.GetSize(); ++i) {
        const QString p = QString("%1.families[%2]").arg(path).arg(i);
        const StringBase f = fams.GetAt(i);
        if (fams.Find(f) != i)
            Fail(p, "duplicate family " + Quote(f.ToQString()));
        if (f == "GT")
            t.supportsGT = true;
        else if (f == "GT10")
            t.supportsGT10 = true;
        else if (f == "GT11")
            t.supportsGT11 = true;
        else
            Fail(p, "unknown family " + Quote(f.ToQString()) + " (GT, GT10 or GT11)");
    }
    const QJsonValue mb = o.value("max_bond");
    if (!mb.isUndefined()) {
        const QString p = path + ".max_bond";
        const QJsonObject m = AsObject(mb, p);
        CheckKeys(m, p, {"GT", "GT10", "GT11"}, {});
        t.maxBondGT = IntAt(m, "GT", p, 0, 0, kMaxBond);
        t.maxBondGT10 = IntAt(m, "GT10", p, 0, 0, kMaxBond);
        t.maxBondGT11 = IntAt(m, "GT11", p, 0, 0, kMaxBond);
    }
    t.fileName = StringAt(o, "file_name", path);
}

Qvz_Family FamilyFromText(const StringBase& f) {
    if (f == "GT")
        return Qvz_Family::GT;
    if (f == "GT10")
        return Qvz_Family::GT10;
    if (f == "GT11")
        return Qvz_Family::GT11;
    return Qvz_Family::Unknown;
}

std::unique_ptr<Qvz_Block> ReadBlock(const QJsonObject& o, const QString& path) {
    CheckKeys(o, path, {"name", "primitive", "family", "used", "attributes", "pins"},
              {"name", "primitive"});
    const StringBase name = StringAt(o, "name", path);
    const StringBase prim = StringAt(o, "primitive", path);
    if (name.IsEmpty())
        Fail(path + ".name", "a block name must not be empty");
    Qvz_Family fam = Qvz_FamilyOfPrimitive(prim);
    if (o.contains("family")) {
        const StringBase f = StringAt(o, "family", path);
        fam = FamilyFromText(f);
        if (fam == Qvz_Family::Unknown)
            Fail(path + ".family", "unknown family " + Quote(f.ToQString()) + " (GT, GT10 or GT11)");
    } else if (fam == Qvz_Family::Unknown) {
        Fail(path + ".primitive", "cannot tell the family of primitive " +
                                      Quote(prim.ToQString()) + "; give \"family\"");
    }
    auto block = std::make_unique<Qvz_Block>(name, prim, fam);
    block->SetIsUsed(BoolAt(o, "used", path, false));

    const QJsonArray attrs = ArrayAt(o, "attributes", path);
    for (qsizetype i = 0; i < attrs.size(); ++i) {
        const QString p = QString("%1.attributes[%2]").arg(path).arg(i);
        const QJsonObject ao = AsObject(attrs.at(i), p);
        CheckKeys(ao, p, {"name", "value", "default", "editable", "changed", "legal"},
                  {"name", "value"});
        const StringBase an = StringAt(ao, "name", p);
        if (block->GetNamedAttribute(an))
            Fail(p + ".name", "duplicate attribute name " + Quote(an.ToQString()));
        const StringBase value = StringAt(ao, "value", p);
        Qvz_Attribute* a = block->AddAttribute(an, value);
        a->SetDefaultValue(StringAt(ao, "default", p, value));
        a->SetEditable(BoolAt(ao, "editable", p, true));
        a->SetChanged(BoolAt(ao, "changed", p, false));
        a->GetLegalValues() = StringsAt(ao, "legal", p);
    }

    const QJsonArray pins = ArrayAt(o, "pins", path);
    for (qsizetype i = 0; i < pins.size(); ++i) {
        const QString p = QString("%1.pins[%2]").arg(path).arg(i);
        const QJsonObject po = AsObject(pins.at(i), p);
        CheckKeys(po, p,
                  {"name", "direction", "width", "data_width", "signal", "grounded", "vcc", "used",
                   "flags", "attributes"},
                  {"name", "direction"});
        const StringBase pn = StringAt(po, "name", p);
        if (block->GetNamedPin(pn))
            Fail(p + ".name", "duplicate pin name " + Quote(pn.ToQString()));
        Qvz_Pin* pin = block->AddPin(pn, StringAt(po, "direction", p));
        pin->SetWidth(IntAt(po, "width", p, 1, 1, Qvz_MaxWidth));
        pin->SetSupportsDataWidth(BoolAt(po, "data_width", p, false));
        pin->SetSigName(StringAt(po, "signal", p));
        pin->SetIsGrounded(BoolAt(po, "grounded", p, false));
        pin->SetIsVcc(BoolAt(po, "vcc", p, false));
        pin->SetIsUsed(BoolAt(po, "used", p, false));
        const Qvz_StrArray flags = StringsAt(po, "flags", p);
        for (const auto& f : flags.Items())
            pin->AddFlag(f);
        ReadNameValues(po, p, pin->AttributeList());
    }
    return block;
}

std::unique_ptr<Qvz_Signal> ReadSignal(const QJsonObject& o, const QString& path) {
    CheckKeys(o, path,
              {"name", "width", "bus", "external", "direction", "const0", "const1", "used",
               "attributes"},
              {"name"});
    auto s = std::make_unique<Qvz_Signal>(StringAt(o, "name", path));
    s->SetWidth(IntAt(o, "width", path, 1, 1, Qvz_MaxWidth));
    s->SetIsBus(BoolAt(o, "bus", path, false), s->GetWidth());
    const StringBase dir = StringAt(o, "direction", path);
    if (!(dir.IsEmpty() || dir == "I" || dir == "O" || dir == "B"))
        Fail(path + ".direction", "expected \"I\", \"O\", \"B\" or \"\"");
    s->SetIsExternal(BoolAt(o, "external", path, false), dir);
    s->SetIsConst0(BoolAt(o, "const0", path, false));
    s->SetIsConst1(BoolAt(o, "const1", path, false));
    s->SetIsUsed(BoolAt(o, "used", path, false));
    Qvz_NameValueList attrs;
    ReadNameValues(o, path, attrs);
    for (const auto& nv : attrs.Items())
        s->SetAttributeValue(nv.name, nv.value);
    return s;
}

void ReadRoot(const QJsonObject& root, Qvz_WizData& data) {
    CheckKeys(root, "$", {"format", "version", "target", "blocks", "signals"},
              {"format", "version"});
    if (root.value("format").toString() != QLatin1String("velomux-design-data"))
        Fail("$.format", "expected \"velomux-design-data\"");
    IntAt(root, "version", "$", 1, 1, 1);
    ReadTarget(root, data.Target());
    const QJsonArray blocks = ArrayAt(root, "blocks", "$");
    for (qsizetype i = 0; i < blocks.size(); ++i) {
        const QString p = QString("$.blocks[%1]").arg(i);
        auto b = ReadBlock(AsObject(blocks.at(i), p), p);
        if (data.GetNamedBlock(b->GetName()))
            Fail(p + ".name", "duplicate block name " + Quote(b->GetName().ToQString()));
        data.AppendNewBlock(std::move(b));
    }
    const QJsonArray sigs = ArrayAt(root, "signals", "$");
    for (qsizetype i = 0; i < sigs.size(); ++i) {
        const QString p = QString("$.signals[%1]").arg(i);
        auto s = ReadSignal(AsObject(sigs.at(i), p), p);
        if (data.GetNamedSignal(s->GetName()))
            Fail(p + ".name", "duplicate signal name " + Quote(s->GetName().ToQString()));
        data.AppendNewSignal(std::move(s));
    }
}

// ------------------------------------------------------------------ writer

class Writer {
public:
    QByteArray out;

    // Text is written as UTF-8; bytes that are not (a host's Latin-1 name, a
    // name cut inside a character) become U+FFFD, so that what is saved can
    // always be read back.
    static std::string Utf8(const std::string& s) {
        bool ascii = true;
        for (unsigned char c : s)
            ascii = ascii && c < 0x80;
        if (ascii)
            return s;
        const QByteArray bytes = QString::fromUtf8(s.data(), qsizetype(s.size())).toUtf8();
        return std::string(bytes.constData(), std::size_t(bytes.size()));
    }

    void Str(const StringBase& s) {
        out += '"';
        for (unsigned char c : Utf8(s.str())) {
            switch (c) {
            case '"':
                out += "\\\"";
                break;
            case '\\':
                out += "\\\\";
                break;
            case '\n':
                out += "\\n";
                break;
            case '\r':
                out += "\\r";
                break;
            case '\t':
                out += "\\t";
                break;
            default:
                if (c < 0x20) {
                    char buf[8];
                    std::snprintf(buf, sizeof buf, "\\u%04x", c);
                    out += buf;
                } else {
                    out += static_cast<char>(c);
                }
            }
        }
        out += '"';
    }
    void Key(const char* k) {
        out += '"';
        out += k;
        out += "\": ";
    }
    void Bool(bool b) { out += b ? "true" : "false"; }
    void Int(int n) { out += QByteArray::number(n); }
    void Strings(const Qvz_StrArray& a) {
        out += '[';
        for (int i = 0; i < a.GetSize(); ++i) {
            if (i)
                out += ", ";
            Str(a.GetAt(i));
        }
        out += ']';
    }
    void NameValues(const std::vector<Qvz_NameValue>& items) {
        out += '[';
        for (std::size_t i = 0; i < items.size(); ++i) {
            if (i)
                out += ", ";
            out += "{\"name\": ";
            Str(items[i].name);
            out += ", \"value\": ";
            Str(items[i].value);
            out += '}';
        }
        out += ']';
    }
    // Writes items one per line, each through fn.
    template <typename Seq, typename Fn> void Lines(const Seq& items, const char* indent, Fn fn) {
        out += '[';
        bool first = true;
        for (const auto& item : items) {
            out += first ? "\n" : ",\n";
            out += indent;
            fn(*item);
            first = false;
        }
        if (!first) {
            out += '\n';
            out += QByteArray(indent).left(qsizetype(std::strlen(indent)) - 2);
        }
        out += ']';
    }
};

} // namespace

namespace Qvz_DesignJson {

bool Load(const QByteArray& text, const QString& source, Qvz_WizData& out, QString& error) {
    QJsonParseError perr;
    const QJsonDocument doc = QJsonDocument::fromJson(text, &perr);
    if (perr.error != QJsonParseError::NoError) {
        const auto [line, col] = LineColumn(text, perr.offset);
        error = QString("%1:%2:%3: invalid JSON: %4").arg(source).arg(line).arg(col).arg(perr.errorString());
        return false;
    }
    QString dupKey;
    const qsizetype dup = FindDuplicateKey(text, dupKey);
    if (dup >= 0) {
        const auto [line, col] = LineColumn(text, dup);
        error = QString("%1:%2:%3: duplicate key %4").arg(source).arg(line).arg(col).arg(Quote(dupKey));
        return false;
    }
    if (!doc.isObject()) {
        error = source + ": $: expected an object";
        return false;
    }
    Qvz_WizData data;
    try {
        ReadRoot(doc.object(), data);
    } catch (const LoadError& e) {
        error = source + ": " + e.message;
        return false;
    }
    out = std::move(data);
    return true;
}

namespace {

// Far beyond any design data; an endless source (a device, a pipe fed
// forever) is refused here instead of exhausting memory.
constexpr qint64 kMaxFileBytes = qint64(1) << 30;

QString CannotRead(const QString& path, const QString& why) {
    return path + ": cannot read: " + why;
}

// Qt resources and platforms without POSIX files.
bool ReadQFile(const QString& path, QByteArray& text, QString& error) {
    QFile f(path);
    if (!f.open(QIODevice::ReadOnly)) {
        error = CannotRead(path, f.errorString());
        return false;
    }
    text = f.read(kMaxFileBytes + 1);
    if (f.error() != QFileDevice::NoError)
        error = CannotRead(path, f.errorString());
    else if (text.size() > kMaxFileBytes)
        error = CannotRead(path, "larger than 1 GiB");
    return error.isEmpty();
}

#ifdef Q_OS_UNIX
constexpr int kPipeWaitMs = 5000;

// A named pipe opened before anyone writes to it reads as at its end, where
// a plain open would have hung for ever: wait a while for a writer, then
// give up. A pipe that has a writer, however slow, is read as usual. Returns
// why reading cannot go on, else "".
QString AwaitPipeWriter(int fd, QByteArray& text) {
    char c;
    ssize_t n;
    do
        n = ::read(fd, &c, 1);
    while (n < 0 && errno == EINTR);
    if (n > 0)
        text.append(c);
    if (n > 0 || (n < 0 && errno == EAGAIN))
        return {};
    if (n < 0)
        return QString::fromLocal8Bit(std::strerror(errno));
    pollfd p{fd, POLLIN, 0};
    int ready;
    do
        ready = ::poll(&p, 1, kPipeWaitMs);
    while (ready < 0 && errno == EINTR);
    if (ready == 0)
        return QString("nobody wrote to this pipe within %1 seconds").arg(kPipeWaitMs / 1000);
    return {};
}

// Only regular files and pipes hold design data.
bool ReadDesignFile(const QString& path, QByteArray& text, QString& error) {
    if (path.startsWith(':'))
        return ReadQFile(path, text, error);
    const int fd =
        ::open(QFile::encodeName(path).constData(), O_RDONLY | O_NONBLOCK | O_NOCTTY | O_CLOEXEC);
    if (fd < 0) {
        error = CannotRead(path, QString::fromLocal8Bit(std::strerror(errno)));
        return false;
    }
    struct stat st {};
    QString why;
    if (::fstat(fd, &st) != 0)
        why = QString::fromLocal8Bit(std::strerror(errno));
    else if (S_ISDIR(st.st_mode))
        error = path + ": is a directory, not a design-data file";
    else if (!S_ISREG(st.st_mode) && !S_ISFIFO(st.st_mode))
        why = "not a regular file";
    if (why.isEmpty() && error.isEmpty() && S_ISFIFO(st.st_mode))
        why = AwaitPipeWriter(fd, text);
    if (why.isEmpty() && error.isEmpty()) {
        ::fcntl(fd, F_SETFL, ::fcntl(fd, F_GETFL) & ~O_NONBLOCK);
        char buf[1 << 16];
        for (;;) {
            const ssize_t n = ::read(fd, buf, sizeof buf);
            if (n < 0 && errno == EINTR)
                continue;
            if (n < 0) {
                why = QString::fromLocal8Bit(std::strerror(errno));
                break;
            }
            if (n == 0)
                break;
            if (text.size() + n > kMaxFileBytes) {
                why = "larger than 1 GiB";
                break;
            }
            text.append(buf, n);
        }
        if (why.isEmpty() && text.isEmpty() && S_ISFIFO(st.st_mode))
            why = "nothing was written to this pipe";
    }
    ::close(fd);
    if (!why.isEmpty())
        error = CannotRead(path, why);
    return error.isEmpty();
}
#else
bool ReadDesignFile(const QString& path, QByteArray& text, QString& error) {
    if (QFileInfo(path).isDir()) {
        error = path + ": is a directory, not a design-data file";
        return false;
    }
    return ReadQFile(path, text, error);
}
#endif

} // namespace

bool LoadFile(const QString& path, Qvz_WizData& out, QString& error) {
    QByteArray text;
    if (!ReadDesignFile(path, text, error))
        return false;
    return Load(text, path, out, error);
}

QByteArray Save(const Qvz_WizData& data) {
    Writer w;
    const Qvz_Target& t = data.Target();
    w.out += "{\n  \"format\": \"velomux-design-data\",\n  \"version\": 1,\n  ";
    w.Key("target");
    w.out += "{";
    w.Key("families");
    Qvz_StrArray fams;
    if (t.supportsGT)
        fams.Add("GT");
    if (t.supportsGT10)
        fams.Add("GT10");
    if (t.supportsGT11)
        fams.Add("GT11");
    w.Strings(fams);
    w.out += ", ";
    w.Key("max_bond");
    w.out += QString("{\"GT\": %1, \"GT10\": %2, \"GT11\": %3}, ")
                 .arg(t.maxBondGT)
                 .arg(t.maxBondGT10)
                 .arg(t.maxBondGT11)
                 .toUtf8();
    w.Key("file_name");
    w.Str(t.fileName);
    w.out += "},\n  ";
    w.Key("blocks");
    w.Lines(data.GetBlocks(), "    ", [&w](const Qvz_Block& b) {
        w.out += "{\n      ";
        w.Key("name");
        w.Str(b.GetName());
        w.out += ", ";
        w.Key("primitive");
        w.Str(b.GetPrimitiveName());
        w.out += ", ";
        w.Key("family");
        w.Str(Qvz_FamilyName(b.GetFamily()));
        w.out += ", ";
        w.Key("used");
        w.Bool(b.IsUsed());
        w.out += ",\n      ";
        w.Key("attributes");
        w.Lines(b.GetAttributes(), "        ", [&w](const Qvz_Attribute& a) {
            w.out += "{\"name\": ";
            w.Str(a.GetName());
            w.out += ", \"value\": ";
            w.Str(a.GetValue());
            w.out += ", \"default\": ";
            w.Str(a.GetDefaultValue());
            w.out += ", \"editable\": ";
            w.Bool(a.IsEditable());
            w.out += ", \"changed\": ";
            w.Bool(a.IsChanged());
            w.out += ", \"legal\": ";
            w.Strings(a.GetLegalValues());
            w.out += '}';
        });
        w.out += ",\n      ";
        w.Key("pins");
        w.Lines(b.GetPins(), "        ", [&w](const Qvz_Pin& p) {
            w.out += "{\"name\": ";
            w.Str(p.GetName());
            w.out += ", \"direction\": ";
            w.Str(p.GetDirection());
            w.out += ", \"width\": ";
            w.Int(p.GetWidth());
            w.out += ", \"data_width\": ";
            w.Bool(p.SupportsDataWidth());
            w.out += ", \"signal\": ";
            w.Str(p.GetSigName());
            w.out += ", \"grounded\": ";
            w.Bool(p.IsGrounded());
            w.out += ", \"vcc\": ";
            w.Bool(p.IsVcc());
            w.out += ", \"used\": ";
            w.Bool(p.IsUsed());
            w.out += ", \"flags\": ";
            w.Strings(p.GetFlags());
            w.out += ", \"attributes\": ";
            w.NameValues(p.GetAttributes());
            w.out += '}';
        });
        w.out += "\n    }";
    });
    w.out += ",\n  ";
    w.Key("signals");
    w.Lines(data.GetSignals(), "    ", [&w](const Qvz_Signal& s) {
        w.out += "{\"name\": ";
        w.Str(s.GetName());
        w.out += ", \"width\": ";
        w.Int(s.GetWidth());
        w.out += ", \"bus\": ";
        w.Bool(s.IsBus());
        w.out += ", \"external\": ";
        w.Bool(s.IsExternal());
        w.out += ", \"direction\": ";
        w.Str(s.GetDirection());
        w.out += ", \"const0\": ";
        w.Bool(s.IsConst0());
        w.out += ", \"const1\": ";
        w.Bool(s.IsConst1());
        w.out += ", \"used\": ";
        w.Bool(s.IsUsed());
        w.out += ", \"attributes\": ";
        w.NameValues(s.GetAttributes());
        w.out += '}';
    });
    w.out += "\n}\n";
    return w.out;
}

} // namespace Qvz_DesignJson
