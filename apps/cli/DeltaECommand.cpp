#include <cstdio>
#include <functional>
#include <map>
#include <memory>
#include <sstream>
#include <stdexcept>
#include <string>
#include <vector>

#include "Commands.h"
#include "DescriptionOptions.h"
#include "Output.h"
#include "ValueLines.h"
#include "pigmo/bp.h"

namespace {

struct DeltaEArguments {
    std::string metric = "ciede2000";
    std::string weights;  // comma-separated
    std::vector<std::string> values;
    bool json = false;
};

struct Metric {
    std::vector<double> defaultWeights;  // their count is the count --weights must give
    const char* weightNames;
    std::function<double(const double*, const double*, const std::vector<double>&)> difference;
};

const std::map<std::string, Metric>& Metrics() {
    static const std::map<std::string, Metric> metrics = {
        {"cie76", {{}, "", [](auto x, auto y, auto&) { return BPCalculateDeltaE(x, y); }}},
        {"squared", {{}, "", [](auto x, auto y, auto&) { return BPCalculateDistanceSquared(x, y); }}},
        {"cmc",
         {{2, 1}, "l,c", [](auto x, auto y, auto& w) { return BPCalculateDeltaECMC(x, y, w[0], w[1]); }}},
        {"cie94",
         {{1, 1, 1},
          "kL,kC,kH",
          [](auto x, auto y, auto& w) { return BPCalculateDeltaE94(x, y, w[0], w[1], w[2]); }}},
        {"ciede2000",
         {{1, 1, 1},
          "kL,kC,kH",
          [](auto x, auto y, auto& w) { return BPCalculateDeltaE2000(x, y, w[0], w[1], w[2]); }}},
    };
    return metrics;
}

std::string MetricNames() {
    std::string names;
    for (const auto& [name, metric] : Metrics()) names += (names.empty() ? "" : ", ") + name;
    return names;
}

std::vector<double> Weights(const std::string& text) {
    std::vector<double> weights;
    std::istringstream items(text);
    for (std::string item; std::getline(items, item, ',');) {
        weights.push_back(ParseNumber(item));
        // Each metric divides by its weights.
        if (!(weights.back() > 0.0)) throw std::invalid_argument("--weights: '" + item + "' is not positive");
    }
    return weights;
}

class PairPrinter {
public:
    explicit PairPrinter(const DeltaEArguments& arguments) : name_(arguments.metric), json_(arguments.json) {
        const auto found = Metrics().find(arguments.metric);
        if (found == Metrics().end()) {
            throw std::invalid_argument("unknown metric '" + arguments.metric + "' (one of " + MetricNames() +
                                        ")");
        }
        metric_ = &found->second;
        weights_ = arguments.weights.empty() ? metric_->defaultWeights : Weights(arguments.weights);
        if (weights_.size() != metric_->defaultWeights.size()) {
            throw std::invalid_argument(metric_->defaultWeights.empty()
                                            ? arguments.metric + " takes no weights"
                                            : arguments.metric + " takes " +
                                                  std::to_string(metric_->defaultWeights.size()) +
                                                  " weights (" + metric_->weightNames + ")");
        }
    }

    // Six numbers: L*, a*, b* of the reference, then of the sample.
    void Print(const std::vector<std::string>& values) const {
        if (values.size() != 6) {
            throw std::invalid_argument("expected 6 values (L a b of two colors), got " +
                                        std::to_string(values.size()));
        }
        double lab[6];
        for (size_t i = 0; i < 6; ++i) lab[i] = ParseNumber(values[i]);
        const double difference = metric_->difference(lab, lab + 3, weights_);
        RequireFinite(&difference, 1);
        if (json_) {
            const nlohmann::ordered_json record = {{"metric", name_},
                                                   {"reference", {lab[0], lab[1], lab[2]}},
                                                   {"sample", {lab[3], lab[4], lab[5]}},
                                                   {"difference", difference}};
            WriteOut(JsonText(record) + "\n");
        } else {
            std::printf("%.10g\n", difference);
        }
    }

private:
    std::string name_;
    bool json_;
    const Metric* metric_ = nullptr;
    std::vector<double> weights_;
};

int RunDeltaE(const DeltaEArguments& arguments) {
    return RunCommand("delta-e", [&] {
        const PairPrinter printer(arguments);
        ForEachValueLine("delta-e", arguments.values,
                         [&](const std::vector<std::string>& values) { printer.Print(values); });
    });
}

}  // namespace

void AddDeltaECommand(CLI::App& app, int& exitCode) {
    auto arguments = std::make_shared<DeltaEArguments>();
    CLI::App* command = app.add_subcommand("delta-e", "Color difference between two CIELAB colors");
    command->add_option("-m,--metric", arguments->metric, "cie76, cmc, cie94, ciede2000 or squared")
        ->capture_default_str();
    command->add_option("-w,--weights", arguments->weights,
                        "cmc: l,c (default 2,1); cie94 and ciede2000: kL,kC,kH (default 1,1,1)");
    command->add_option("VALUES", arguments->values,
                        "L a b of the reference, then L a b of the sample; without them, one pair of six "
                        "numbers per line is read from standard input");
    command->add_flag("--json", arguments->json,
                      "print each difference as a JSON object with the metric and the two colors");
    command->footer(
        "CMC and CIE94 weight by the reference, so the order of the two colors matters. Each difference is "
        "printed on one line with 10 significant digits.\n"
        "Example: pigmo delta-e -m cmc -w 2,1 50 20 -30 55 18 -25");
    command->callback([arguments, &exitCode] { exitCode = RunDeltaE(*arguments); });
}
