// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/layout/VisualFormat.h"

#include "kit/layout/LayoutItem.h"
#include "kit/values/PlatformNames.h"
#include "platform/Log.h"

#include <cctype>
#include <charconv>

namespace kit {

namespace {

// The platform's standard distances, in points.
constexpr double standardSpacing = 8;
constexpr double standardMargin = 20;

/// One condition on a length: "(>=50@750)", "(==other)", "12".
struct Predicate {
    LayoutRelation relation = LayoutRelation::Equal;
    double constant = 0;
    std::shared_ptr<LayoutItem> view; ///< the length of this view, instead of the constant
    LayoutPriority priority = LayoutPriorities::required;
};

using Predicates = std::vector<Predicate>;

Predicates exactly(double constant)
{
    Predicate predicate;
    predicate.constant = constant;
    return {predicate};
}

/// A view of the format, or the superview at its edge.
struct Item {
    std::shared_ptr<LayoutItem> view;
    bool isSuperview = false;
};

/// Reads one format from left to right and stops at the first error.
class Parser {
public:
    Parser(std::string_view format, const VisualFormatInput& input)
        : _format(format)
        , _input(input)
    {
    }

    VisualFormatResult parse()
    {
        parseOrientation();
        std::optional<Item> before = parseItem();
        if (!before)
            fail("expected '|' or '['");
        while (!_error && before && _position < _format.size()) {
            const auto connection = parseConnection();
            const auto after = _error ? std::nullopt : parseItem();
            if (!_error && !after)
                fail("expected '|' or '['");
            if (_error)
                break;
            connect(*before, *after, connection);
            if (after->isSuperview && _position < _format.size())
                fail("nothing may follow the superview's edge");
            before = after;
        }
        if (!_error && _views.empty())
            fail("expected a view");
        align();
        if (_error)
            return {{}, _error};
        return {std::move(_made), std::nullopt};
    }

private:
    void fail(std::string message)
    {
        if (!_error)
            _error = VisualFormatError{_position, std::move(message)};
    }
    void failAt(std::size_t position, std::string message)
    {
        if (!_error)
            _error = VisualFormatError{position, std::move(message)};
    }

    char peek() const { return _position < _format.size() ? _format[_position] : '\0'; }
    bool accept(std::string_view token)
    {
        if (!_format.substr(_position).starts_with(token))
            return false;
        _position += token.size();
        return true;
    }
    void expect(std::string_view token)
    {
        if (!_error && !accept(token))
            fail("expected '" + std::string(token) + "'");
    }

    void parseOrientation()
    {
        if (accept("V:"))
            _axis = Axis::Vertical;
        else
            accept("H:");
    }

    std::string_view parseName()
    {
        const auto start = _position;
        while (std::isalnum(static_cast<unsigned char>(peek())) || peek() == '_')
            ++_position;
        return _format.substr(start, _position - start);
    }

    std::optional<Item> parseItem()
    {
        if (accept("|"))
            return Item{nullptr, true};
        if (!accept("["))
            return std::nullopt;
        const auto start = _position;
        const auto name = parseName();
        const auto found = _input.views.find(name);
        if (found == _input.views.end() || !found->second) {
            failAt(start, "no view is named '" + std::string(name) + "'");
            return std::nullopt;
        }
        const auto view = found->second;
        if (peek() == '(')
            addLengths(*view, parsePredicates());
        expect("]");
        _views.push_back(view);
        return Item{view, false};
    }

    /// Answers nothing when the views touch, and no predicates when they have the standard distance.
    std::optional<Predicates> parseConnection()
    {
        if (!accept("-"))
            return std::nullopt;
        if (peek() == '[' || peek() == '|')
            return Predicates{};
        auto predicates = peek() == '(' ? parsePredicates() : exactly(parseNumber());
        expect("-");
        return predicates;
    }

    Predicates parsePredicates()
    {
        Predicates predicates;
        expect("(");
        do {
            predicates.push_back(parsePredicate());
        } while (!_error && accept(","));
        expect(")");
        return predicates;
    }

    Predicate parsePredicate()
    {
        Predicate predicate;
        if (accept("<="))
            predicate.relation = LayoutRelation::LessThanOrEqual;
        else if (accept(">="))
            predicate.relation = LayoutRelation::GreaterThanOrEqual;
        else
            accept("==");
        if (!parseOtherView(predicate))
            predicate.constant = parseNumber();
        if (accept("@"))
            parsePriority(predicate);
        return predicate;
    }

    bool parseOtherView(Predicate& predicate)
    {
        const auto start = _position;
        const auto found = _input.views.find(parseName());
        if (found != _input.views.end() && found->second) {
            predicate.view = found->second;
            return true;
        }
        _position = start;
        return false;
    }

    void parsePriority(Predicate& predicate)
    {
        const auto start = _position;
        const double priority = parseNumber();
        if (!_error && (priority < 1 || priority > LayoutPriorities::required))
            failAt(start, "a priority lies between 1 and 1000");
        predicate.priority = static_cast<LayoutPriority>(priority);
    }

    double parseNumber()
    {
        double number = 0;
        const char* begin = _format.data() + _position;
        // The library would also find "inf" and "nan" at the beginning of a name.
        const auto digits = _format.substr(_position + (peek() == '-' ? 1 : 0));
        const bool hasDigits =
            !digits.empty() && (std::isdigit(static_cast<unsigned char>(digits[0])) || digits[0] == '.');
        const auto read = hasDigits ? std::from_chars(begin, _format.data() + _format.size(), number)
                                    : std::from_chars_result{begin, std::errc::invalid_argument};
        if (read.ec == std::errc()) {
            _position += static_cast<std::size_t>(read.ptr - begin);
            return number;
        }
        const auto start = _position;
        const auto name = parseName();
        const auto metric = _input.metrics.find(name);
        if (metric != _input.metrics.end())
            return metric->second;
        failAt(start, name.empty() ? "expected a number" : "no metric is named '" + std::string(name) + "'");
        return 0;
    }

    LayoutAttribute start() const { return horizontal() ? LayoutAttribute::Leading : LayoutAttribute::Top; }
    LayoutAttribute end() const { return horizontal() ? LayoutAttribute::Trailing : LayoutAttribute::Bottom; }
    LayoutAttribute length() const { return horizontal() ? LayoutAttribute::Width : LayoutAttribute::Height; }
    bool horizontal() const { return _axis == Axis::Horizontal; }

    void add(const LayoutAnchor& first, LayoutRelation relation, const LayoutAnchor& second, double constant,
        LayoutPriority priority)
    {
        _made.push_back(std::make_shared<LayoutConstraint>(first, relation, second, 1, constant));
        _made.back()->setPriority(priority);
    }

    void addLengths(const LayoutItem& view, const Predicates& predicates)
    {
        for (const auto& predicate : predicates) {
            const auto other = predicate.view ? predicate.view->anchor(length()) : LayoutAnchor();
            add(view.anchor(length()), predicate.relation, other, predicate.constant, predicate.priority);
        }
    }

    void connect(const Item& before, const Item& after, const std::optional<Predicates>& connection)
    {
        const bool atEdge = before.isSuperview || after.isSuperview;
        const auto inner = before.isSuperview ? after.view : before.view;
        const auto superview = atEdge && inner ? inner->layoutParent() : nullptr;
        if (atEdge && !superview)
            return fail("the view at the edge has no superview");
        const auto near = before.isSuperview ? superview->anchor(start()) : before.view->anchor(end());
        const auto far = after.isSuperview ? superview->anchor(end()) : after.view->anchor(start());
        auto predicates = connection.value_or(exactly(0));
        if (predicates.empty())
            predicates = exactly(atEdge ? standardMargin : standardSpacing);
        for (const auto& predicate : predicates) {
            if (predicate.view)
                return fail("a distance is no view");
            add(far, predicate.relation, near, predicate.constant, predicate.priority);
        }
    }

    void align()
    {
        if (_error || _input.alignment == LayoutAttribute::None)
            return;
        for (std::size_t index = 1; index < _views.size(); ++index)
            add(_views[index]->anchor(_input.alignment), LayoutRelation::Equal,
                _views[index - 1]->anchor(_input.alignment), 0, LayoutPriorities::required);
    }

    std::string_view _format;
    const VisualFormatInput& _input;
    std::size_t _position = 0;
    Axis _axis = Axis::Horizontal;
    std::vector<std::shared_ptr<LayoutItem>> _views;
    LayoutConstraints _made;
    std::optional<VisualFormatError> _error;
};

} // namespace

VisualFormatResult VisualFormat::parse(std::string_view format, const VisualFormatInput& input)
{
    return Parser(format, input).parse();
}

LayoutConstraints VisualFormat::constraints(std::string_view format, const VisualFormatInput& input)
{
    static constexpr Operation op{"+[VisualFormat constraintsWithFormat:]"};
    auto result = parse(format, input);
    if (result.error)
        op.error(
            "%{public}@ at %zu of \"%{public}@\"", result.error->message, result.error->position, format);
    return std::move(result.constraints);
}

} // namespace kit
