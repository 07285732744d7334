#include "platform/ui/layout_solver.h"

#include <algorithm>
#include <cmath>
#include <map>

#include "platform/ui/view.h"

namespace wp::ui {
namespace {

constexpr double kTolerance = 1e-6;

/// A sum of variables, each with its factor, and a constant. Variables are numbered: four for each view.
struct Expression {
    std::map<int, double> terms;
    double constant = 0;

    void add(const Expression& other, double factor) {
        for (auto [variable, coefficient] : other.terms) addTerm(variable, coefficient * factor);
        constant += other.constant * factor;
    }
    void addTerm(int variable, double coefficient) {
        double& sum = terms[variable];
        sum += coefficient;
        if (std::abs(sum) < kTolerance) terms.erase(variable);
    }
};

/// A constraint as the solver sees it: expression = 0, or >= 0.
struct Demand {
    Expression expression;
    Relation relation = Relation::equal;
    Priority priority = priority::required;
    std::string text;
    bool isActive = false;  ///< an inequality that is held as an equality
};

/// Variables expressed by others, kept fully reduced: no solved variable stands on a right-hand side.
class Rows {
  public:
    enum class Outcome { held, redundant, contradicted };

    Outcome hold(const Expression& demand) {
        Expression reduced = reduce(demand);
        if (reduced.terms.empty())
            return std::abs(reduced.constant) < kTolerance ? Outcome::redundant : Outcome::contradicted;
        auto [variable, coefficient] = *reduced.terms.rbegin();
        reduced.terms.erase(variable);
        Expression solved;
        solved.add(reduced, -1 / coefficient);
        for (auto& [other, row] : rows_) {
            auto found = row.terms.find(variable);
            if (found == row.terms.end()) continue;
            double factor = found->second;
            row.terms.erase(found);
            row.add(solved, factor);
        }
        rows_.emplace(variable, std::move(solved));
        return Outcome::held;
    }

    /// The value with every variable that nothing decides at 0.
    double value(const Expression& expression) const { return reduce(expression).constant; }
    bool isDecided(int variable) const {
        auto found = rows_.find(variable);
        return found != rows_.end() && found->second.terms.empty();
    }

  private:
    Expression reduce(const Expression& expression) const {
        Expression result;
        result.constant = expression.constant;
        for (auto [variable, coefficient] : expression.terms) {
            auto found = rows_.find(variable);
            if (found == rows_.end()) {
                result.addTerm(variable, coefficient);
            } else {
                result.add(found->second, coefficient);
            }
        }
        return result;
    }

    std::map<int, Expression> rows_;
};

enum Coordinate { kX, kY, kWidth, kHeight, kCoordinates };

class Layout {
  public:
    explicit Layout(View& root) { collect(root); }

    LayoutReport solve() {
        // Text that wraps has its height only once its width is known: measure again with what came out.
        constexpr int kPasses = 4;
        LayoutReport report;
        for (int pass = 0; pass < kPasses; ++pass) {
            std::vector<double> before = values_;
            report = solveOnce();
            if (values_ == before) break;
        }
        apply();
        return report;
    }

  private:
    void collect(View& view) {
        numbers_[&view] = static_cast<int>(views_.size());
        views_.push_back(&view);
        values_.resize(views_.size() * kCoordinates, 0);
        for (const auto& subview : view.subviews()) collect(*subview);
    }

    int variable(const View& view, Coordinate coordinate) const {
        return numbers_.at(&view) * kCoordinates + coordinate;
    }

    Expression sum(const View& view, std::initializer_list<std::pair<Coordinate, double>> terms,
                   double constant = 0) const {
        Expression result;
        for (auto [coordinate, factor] : terms) result.addTerm(variable(view, coordinate), factor);
        result.constant = constant;
        return result;
    }

    double settledWidth(const View& view) const { return values_[variable(view, kWidth)]; }

    Expression expression(const Anchor& anchor) const {
        const View& view = *anchor.view;
        switch (anchor.attribute) {
            case Attribute::none:
                return {};
            case Attribute::top:
                return sum(view, {{kY, 1}});
            case Attribute::bottom:
                return sum(view, {{kY, 1}, {kHeight, 1}});
            case Attribute::leading:
                return sum(view, {{kX, 1}});
            case Attribute::trailing:
                return sum(view, {{kX, 1}, {kWidth, 1}});
            case Attribute::width:
                return sum(view, {{kWidth, 1}});
            case Attribute::height:
                return sum(view, {{kHeight, 1}});
            case Attribute::centerX:
                return sum(view, {{kX, 1}, {kWidth, 0.5}});
            case Attribute::centerY:
                return sum(view, {{kY, 1}, {kHeight, 0.5}});
            case Attribute::lastBaseline:
                return sum(view, {{kY, 1}, {kHeight, 1}},
                           -view.lastBaselineOffsetFromBottom(settledWidth(view)));
        }
        return {};
    }

    std::vector<Demand> demands() const {
        std::vector<Demand> all;
        for (const View* view : views_) {
            if (!view->superview() || !view->isLaidOutByConstraints()) addOwnFrame(*view, all);
        }
        for (const View* view : views_) {
            for (const LayoutConstraint& constraint : view->constraints()) {
                Demand demand;
                demand.expression = expression(constraint.first);
                if (constraint.second.view) demand.expression.add(expression(constraint.second), -1);
                demand.expression.constant -= constraint.constant;
                demand.relation = constraint.relation;
                demand.priority = constraint.priority;
                demand.text = constraint.text();
                all.push_back(demand);
                if (constraint.relation == Relation::equal) continue;
                demand.relation = Relation::equal;
                demand.priority = priority::settle;
                all.push_back(std::move(demand));
            }
            if (view->superview() && view->isLaidOutByConstraints()) addContentSize(*view, all);
        }
        std::stable_sort(all.begin(), all.end(), [](const Demand& left, const Demand& right) {
            return left.priority > right.priority;
        });
        return all;
    }

    void addOwnFrame(const View& view, std::vector<Demand>& all) const {
        const Rect& frame = view.frame();
        Expression x = sum(view, {{kX, 1}}, -frame.x);
        Expression y = sum(view, {{kY, 1}}, -frame.y);
        if (const View* above = view.superview()) {
            x.add(sum(*above, {{kX, 1}}), -1);
            y.add(sum(*above, {{kY, 1}}), -1);
        }
        all.push_back({std::move(x), {}, priority::required, {}});
        all.push_back({std::move(y), {}, priority::required, {}});
        all.push_back({sum(view, {{kWidth, 1}}, -frame.width), {}, priority::required, {}});
        all.push_back({sum(view, {{kHeight, 1}}, -frame.height), {}, priority::required, {}});
    }

    void addContentSize(const View& view, std::vector<Demand>& all) const {
        View::IntrinsicSize content = view.intrinsicSize(settledWidth(view));
        auto add = [&](Coordinate coordinate, Axis axis, double size) {
            Expression difference = sum(view, {{coordinate, 1}}, -size);
            all.push_back({difference, Relation::equal, view.contentHuggingPriority(axis), {}});
            all.push_back(
                {difference, Relation::greaterOrEqual, view.compressionResistancePriority(axis), {}});
        };
        if (content.width) add(kWidth, Axis::horizontal, *content.width);
        if (content.height) add(kHeight, Axis::vertical, *content.height);
    }

    LayoutReport solveOnce() {
        std::vector<Demand> all = demands();
        for (;;) {
            LayoutReport report;
            Rows rows = holdAll(all, report);
            auto violated = std::find_if(all.begin(), all.end(), [&](const Demand& demand) {
                return demand.relation == Relation::greaterOrEqual && !demand.isActive &&
                       rows.value(demand.expression) < -kTolerance;
            });
            if (violated == all.end()) return settle(rows, std::move(report));
            violated->isActive = true;
        }
    }

    static Rows holdAll(const std::vector<Demand>& all, LayoutReport& report) {
        Rows rows;
        for (const Demand& demand : all) {
            if (demand.relation == Relation::greaterOrEqual && !demand.isActive) continue;
            bool isLost = rows.hold(demand.expression) == Rows::Outcome::contradicted;
            if (isLost && demand.priority >= priority::required) report.conflicts.push_back(demand.text);
        }
        return rows;
    }

    LayoutReport settle(const Rows& rows, LayoutReport report) {
        constexpr const char* kNames[] = {"x", "y", "width", "height"};
        for (const View* view : views_) {
            for (Coordinate coordinate : {kX, kY, kWidth, kHeight}) {
                int number = variable(*view, coordinate);
                values_[number] = rows.value(sum(*view, {{coordinate, 1}}));
                if (rows.isDecided(number)) continue;
                const std::string& name = view->identifier();
                report.ambiguous.push_back((name.empty() ? "view" : name) + "." + kNames[coordinate]);
            }
        }
        return report;
    }

    void apply() const {
        for (View* view : views_) {
            if (!view->superview() || !view->isLaidOutByConstraints()) continue;
            const View& above = *view->superview();
            view->setFrame({values_[variable(*view, kX)] - values_[variable(above, kX)],
                            values_[variable(*view, kY)] - values_[variable(above, kY)],
                            values_[variable(*view, kWidth)], values_[variable(*view, kHeight)]});
        }
    }

    std::vector<View*> views_;
    std::map<const View*, int> numbers_;
    std::vector<double> values_;
};

}  // namespace

LayoutReport solveLayout(View& root) {
    return Layout(root).solve();
}

}  // namespace wp::ui
