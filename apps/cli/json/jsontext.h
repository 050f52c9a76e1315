// JSON text, written value by value: the one writer of all results.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

/// How a real number is spelled. Both read back as the same double.
enum class JSON_REALS {
    Shortest, // 1, 0.1, 1e+05
    WithPoint // 1.0, 0.1, 100000.0: told from a whole number
};

/// Where the items of an object or a list stand: each on a line of its own behind so many blanks,
/// and the closing bracket behind its own.
struct T_JSON_LAYOUT {
    int item, end;
    bool breakEmpty = false; // the closing bracket on its own line even when there is no item
};
inline constexpr T_JSON_LAYOUT kJsonOneLine{-1, -1}; // all behind the opening bracket
inline constexpr T_JSON_LAYOUT kJsonNested{-2, -2};  // a blank more than what it stands in

/// Values follow one another in the order of the calls; whoever opens an object or a list closes it
/// with End. A value that does not exist, and a number that is not finite, is null.
class CJsonText {
public:
    explicit CJsonText(JSON_REALS reals) : m_reals(reals) {}

    void Object(T_JSON_LAYOUT layout = kJsonNested) { Open('{', layout); }
    void List(T_JSON_LAYOUT layout = kJsonNested) { Open('[', layout); }
    void End();

    /// The name of the member that comes next.
    CJsonText& Key(std::string_view name);
    /// The next item stands on the line of the one before.
    CJsonText& Beside();

    void Value(std::nullptr_t);
    void Value(bool value);
    void Value(int value);
    void Value(std::size_t value);
    void Value(double value);
    void Value(const char* text) { Value(std::string_view(text)); }
    void Value(const std::string& text) { Value(std::string_view(text)); }
    void Value(std::string_view text);
    template <class T>
    void Value(const std::optional<T>& value)
    {
        if (value)
            Value(*value);
        else
            Value(nullptr);
    }

    /// Key and Value.
    template <class T>
    CJsonText& Member(std::string_view name, const T& value)
    {
        Key(name).Value(value);
        return *this;
    }
    /// A list of the values of any range; by a name it is a member.
    template <class RANGE>
    void Items(const RANGE& values, T_JSON_LAYOUT layout)
    {
        List(layout);
        for (const auto& value : values)
            Value(value);
        End();
    }
    template <class RANGE>
    CJsonText& Items(std::string_view name, const RANGE& values, T_JSON_LAYOUT layout)
    {
        Key(name).Items(values, layout);
        return *this;
    }

    /// The whole text with a line end.
    std::string Text() const { return m_text + "\n"; }

private:
    struct T_OPEN {
        char close;
        T_JSON_LAYOUT layout;
        bool any = false; // an item has been written
    };
    void Open(char bracket, T_JSON_LAYOUT layout);
    /// What stands before an item: a comma, a line end, blanks.
    void Before();
    void Break(int blanks);

    JSON_REALS m_reals;
    std::string m_text;
    std::vector<T_OPEN> m_open;
    bool m_named = false, m_beside = false;
};
