#include "app/FormNumbers.h"

#include <algorithm>
#include <cmath>
#include <set>
#include <utility>

#include "content/MathOperations.h"
#include "content/MathTokens.h"

namespace plume {

namespace {

// The names in a formula, without functions. One that is assigned to before it is read is left out when it is `own`.
std::set<std::u16string> namesNeededBy(const std::u16string& expression, const std::u16string& own) {
    std::set<std::u16string> names;
    bool setsOwn = false;
    try {
        Tokens tokens(expression);
        for (Token token = tokens.next(); token.kind != TokenKind::End; token = tokens.next()) {
            if (token.kind != TokenKind::Name || functionNamed(token.name) != nullptr) continue;
            if (token.name == own) {
                setsOwn = setsOwn || (!names.contains(own) && tokens.take(u'='));
                if (setsOwn) continue;
            }
            names.emplace(token.name);
        }
    } catch (const MathExpressionError&) {
        // It is told when the formula is evaluated.
    }
    return names;
}

}  // namespace

void FormNumbers::add(const std::u16string& name, std::optional<Given> given, const std::u16string& expression) {
    const auto [place, isNew] = places_.try_emplace(name, numbers_.size());
    if (isNew) numbers_.emplace_back().name = name;
    Number& number = numbers_[place->second];
    give(number, std::move(given));
    number.expression = expression;
}

void FormNumbers::give(Number& number, std::optional<Given> given) {
    number.isGiven = true;
    number.value.reset();
    number.shown.clear();
    if (!given) return;
    number.value = given->value;
    number.shown = std::move(given->shown);
}

const FormNumbers::Number* FormNumbers::find(const std::u16string& name) const {
    const auto found = places_.find(name);
    return found == places_.end() ? nullptr : &numbers_[found->second];
}

void FormNumbers::evaluateAll() {
    std::vector<std::size_t> formulas;
    for (std::size_t index = 0; index < numbers_.size(); ++index) {
        if (numbers_[index].expression.empty()) continue;
        findNeeds(index);
        formulas.push_back(index);
    }
    findCircles();
    evaluate(formulas);
}

void FormNumbers::findNeeds(std::size_t index) {
    Number& number = numbers_[index];
    for (const std::u16string& name : namesNeededBy(number.expression, number.name)) {
        const auto needed = places_.find(name);
        if (needed == places_.end()) continue;
        number.needs.push_back(needed->second);
        numbers_[needed->second].followers.push_back(index);
    }
}

// Each number behind what it needs, as far as there are no circles.
std::vector<std::size_t> FormNumbers::neededFirst() const {
    struct Step {
        std::size_t number;
        std::size_t nextNeed = 0;
    };
    std::vector<std::size_t> order;
    std::vector<bool> isSeen(numbers_.size());
    std::vector<Step> way;
    for (std::size_t start = 0; start < numbers_.size(); ++start) {
        if (isSeen[start]) continue;
        isSeen[start] = true;
        way.push_back({start});
        while (!way.empty()) {
            Step& step = way.back();
            const auto& needs = numbers_[step.number].needs;
            if (step.nextNeed == needs.size()) {
                order.push_back(step.number);
                way.pop_back();
                continue;
            }
            const std::size_t need = needs[step.nextNeed++];
            if (!isSeen[need]) way.push_back({need});
            isSeen[need] = true;
        }
    }
    return order;
}

// From the one that is needed least: those of its followers' followers that were not reached before need it, too.
void FormNumbers::findCircles() {
    const std::vector<std::size_t> order = neededFirst();
    std::vector<bool> isReached(numbers_.size());
    for (auto start = order.rbegin(); start != order.rend(); ++start) {
        if (isReached[*start]) continue;
        isReached[*start] = true;
        std::vector<std::size_t> group = {*start};
        for (std::size_t next = 0; next < group.size(); ++next) {
            for (const std::size_t follower : numbers_[group[next]].followers) {
                if (!isReached[follower]) group.push_back(follower);
                isReached[follower] = true;
            }
        }
        const auto& needs = numbers_[*start].needs;
        const bool needsItself = std::find(needs.begin(), needs.end(), *start) != needs.end();
        for (const std::size_t number : group) numbers_[number].isInCircle = group.size() > 1 || needsItself;
    }
}

void FormNumbers::setValue(const std::u16string& name, std::optional<Given> given) {
    const auto place = places_.find(name);
    if (place == places_.end()) return;
    give(numbers_[place->second], std::move(given));
    evaluate(followersOf(place->second));
}

// All that follow from it, directly or through others, but not itself.
std::vector<std::size_t> FormNumbers::followersOf(std::size_t index) const {
    std::vector<std::size_t> all = {index};
    std::vector<bool> isSeen(numbers_.size());
    isSeen[index] = true;
    for (std::size_t next = 0; next < all.size(); ++next) {
        for (const std::size_t follower : numbers_[all[next]].followers) {
            if (!isSeen[follower]) all.push_back(follower);
            isSeen[follower] = true;
        }
    }
    all.erase(all.begin());
    return all;
}

// Those in circles, and what needs them, wait for ever and stay without a value.
void FormNumbers::evaluate(const std::vector<std::size_t>& pending) {
    std::vector<bool> isPending(numbers_.size());
    for (const std::size_t index : pending) isPending[index] = true;
    std::vector<std::size_t> waitsFor(numbers_.size());
    std::vector<std::size_t> ready;
    for (const std::size_t index : pending) {
        Number& number = numbers_[index];
        number.value.reset();
        number.isGiven = false;
        number.problem = number.isInCircle ? FormProblem::CircularFormula : FormProblem::MissingNumber;
        waitsFor[index] = static_cast<std::size_t>(
            std::count_if(number.needs.begin(), number.needs.end(), [&](std::size_t need) { return isPending[need]; }));
        if (waitsFor[index] == 0) ready.push_back(index);
    }
    for (std::size_t next = 0; next < ready.size(); ++next) {
        Number& number = numbers_[ready[next]];
        compute(number);
        for (const std::size_t follower : number.followers) {
            if (isPending[follower] && --waitsFor[follower] == 0) ready.push_back(follower);
        }
    }
}

void FormNumbers::compute(Number& number) {
    number.problem = FormProblem::MissingNumber;
    for (const std::size_t need : number.needs) {
        if (!numbers_[need].value) return;
        // A formula may have assigned to the name since.
        parser_.setSymbolValue(*numbers_[need].value, numbers_[need].name);
    }
    parser_.setSymbolValue(0, number.name);
    number.problem = FormProblem::UnreadableFormula;
    try {
        const double value = parser_.evaluate(number.expression);
        if (!std::isfinite(value)) return;
        number.value = value;
        number.problem = FormProblem::None;
    } catch (const MathExpressionError&) {
        // A formula that cannot be read has no value, and neither has what needs it.
    }
}

}  // namespace plume
