#include "query/Quantile.h"

#include <algorithm>
#include <memory>
#include <sqlite3.h>
#include <utility>
#include <vector>

namespace pallax {

namespace {

struct Weighted {
    std::vector<std::pair<double, double>> values; ///< with their weights
    double share = 0;
    std::size_t most = 256; ///< values before equal ones are joined: levels have few different ones

    void join() {
        std::sort(values.begin(), values.end());
        auto last = values.begin();
        for (auto each = values.begin(); each != values.end(); ++each) {
            if (each != last && each->first == last->first) {
                last->second += each->second;
            } else if (each != last) {
                *++last = *each;
            }
        }
        values.erase(values.empty() ? last : last + 1, values.end());
        most = std::max(most, values.size() * 2);
    }
};

bool isNumber(sqlite3_value* value) {
    const int type = sqlite3_value_type(value);
    return type == SQLITE_INTEGER || type == SQLITE_FLOAT;
}

/// SQLite keeps only bytes for a group, all zero at first: a pointer.
Weighted** weightedOf(sqlite3_context* context, bool isNew) {
    return static_cast<Weighted**>(
        sqlite3_aggregate_context(context, isNew ? static_cast<int>(sizeof(void*)) : 0));
}

void step(sqlite3_context* context, int /*count*/, sqlite3_value** arguments) {
    Weighted** held = weightedOf(context, true);
    if (held == nullptr) {
        return sqlite3_result_error_nomem(context);
    }
    if (*held == nullptr) {
        *held = std::make_unique<Weighted>().release();
    }
    constexpr std::size_t kMostValues = std::size_t{8} << 20U; // 128 MiB
    if ((*held)->values.size() >= (*held)->most) {
        (*held)->join();
    }
    if ((*held)->values.size() >= kMostValues) {
        return sqlite3_result_error(context, "quantile() takes at most 8,388,608 different values",
                                    -1);
    }
    const double weight = sqlite3_value_double(arguments[1]);
    if (isNumber(arguments[0]) && weight > 0) {
        (*held)->values.emplace_back(sqlite3_value_double(arguments[0]), weight);
    }
    (*held)->share = sqlite3_value_double(arguments[2]);
}

void finish(sqlite3_context* context) {
    Weighted** held = weightedOf(context, false);
    if (held == nullptr || *held == nullptr) {
        return; // NULL
    }
    const std::unique_ptr<Weighted> weighted(std::exchange(*held, nullptr));
    auto& values = weighted->values;
    if (values.empty()) {
        return;
    }
    weighted->join();
    double all = 0;
    for (const auto& [value, weight] : values) {
        all += weight;
    }
    double sum = 0;
    for (const auto& [value, weight] : values) {
        sum += weight;
        if (sum >= weighted->share * all) {
            return sqlite3_result_double(context, value);
        }
    }
    sqlite3_result_double(context, values.back().first);
}

} // namespace

bool addQuantile(sqlite3& connection) {
    constexpr int kArguments = 3;
    return sqlite3_create_function_v2(&connection, "quantile", kArguments,
                                      SQLITE_UTF8 | SQLITE_DETERMINISTIC, nullptr, nullptr, step,
                                      finish, nullptr) == SQLITE_OK;
}

} // namespace pallax
