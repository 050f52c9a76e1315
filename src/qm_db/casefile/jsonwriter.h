// Prints JSON: keys in the order of the calls, objects indented by one blank, arrays of numbers on
// one line or wrapped. A value that can't be printed makes a fault with its place; the first one
// is kept.
#pragma once

#include "qm_base/say.h"
#include "qm_db/fileerror.h"
#include "qm_db/records/units.h"

#include <span>
#include <string>
#include <string_view>
#include <vector>

class CJsonWriter {
public:
    /// Numbers with a dimension are SI values and are printed in `units`.
    explicit CJsonWriter(const T_UNITS& units) : m_units(units) {}

    /// The name of the next value inside an object.
    void Key(std::string_view key);
    void BeginObject(bool oneLine = false) { Begin('{', oneLine); }
    void EndObject() { End('}'); }
    void BeginArray() { Begin('[', false); }
    void EndArray() { End(']'); }

    void Value(double value, T_DIM dim = kDimNone);
    void Value(int value);
    void Value(bool value);
    void Value(std::string_view value);
    void Value(const char* value) { Value(std::string_view(value)); }
    void Value(std::span<const double> values, T_DIM dim = kDimNone);
    /// Each with its dimension, or all with the one that is given.
    void Value(std::span<const double> values, std::span<const T_DIM> dims);
    void Value(std::span<const int> values);
    void Value(std::span<const std::string> values);

    template <class T>
    void Member(std::string_view key, const T& value)
    {
        Key(key);
        Value(value);
    }
    template <class T>
    void Member(std::string_view key, const T& value, T_DIM dim)
    {
        Key(key);
        Value(value, dim);
    }
    /// A member that is left out when the optional is empty.
    template <class T>
    void MemberIf(std::string_view key, const T& value)
    {
        if (value) Member(key, *value);
    }

    bool Failed() const { return m_error.fault != FILE_FAULT::None; }
    /// Records a fault of the value that is being written, unless there is one already. The reason
    /// is a key of the message catalogue, whose places `args` take.
    template <class... ARGS>
    void Fail(std::string_view reason, const ARGS&... args)
    {
        if (!Failed()) FailWith(Say(reason, args...));
    }
    const T_FILE_ERROR& Error() const { return m_error; }
    /// The text so far; the writer is used up.
    std::string TakeText() { return std::move(m_text); }

private:
    struct T_LEVEL {
        bool oneLine = false;
        bool isArray = false;
        std::size_t count = 0;
        std::string key; // of the member that is being written
    };

    /// The fault in words.
    void FailWith(const std::string& words);
    void Begin(char bracket, bool oneLine);
    void End(char bracket);
    void BeforeValue();
    void Separate();
    void NewLine(std::size_t indent);
    void AppendText(std::string_view text);
    void AppendNumbers(const std::string& joined);

    T_UNITS m_units;
    std::string m_text;
    std::size_t m_lineStart = 0; // offset of the last line in m_text
    std::vector<T_LEVEL> m_levels;
    T_FILE_ERROR m_error;
};
