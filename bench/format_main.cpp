// What texts that depend on a number cost: the filling of a text without branches, the question whether it has any,
// which such a text pays for nothing, and the filling of one that has.
#include <benchmark/benchmark.h>

#include <memory>
#include <string>

#include "linux/locale/IcuPluralRules.h"
#include "linux/locale/QtLocalization.h"
#include "platform/base/Format.h"
#include "platform/base/Platform.h"
#include "platform/base/PluralText.h"

namespace {

using ktr::platform::FormatArguments;
using ktr::platform::formatted;
using ktr::platform::Platform;

const std::string kPlain = "Located %@ minutes ago";
const std::string kPlural =
    "{0, plural, one{%@ минуту назад} few{%@ минуты назад} many{%@ минут назад} other{%@ минуты назад}}";

void PlainText(benchmark::State& state) {
    const FormatArguments arguments = {"22"};
    for (auto _ : state) {
        benchmark::DoNotOptimize(formatted(kPlain, arguments));
    }
}
BENCHMARK(PlainText);

void AskingAPlainText(benchmark::State& state) {
    std::string_view text = kPlain;
    for (auto _ : state) {
        benchmark::DoNotOptimize(text);
        benchmark::DoNotOptimize(ktr::platform::PluralText::isPlural(text));
    }
}
BENCHMARK(AskingAPlainText);

void PluralText(benchmark::State& state) {
    const auto platform = std::make_shared<Platform>();
    platform->pluralRules = std::make_shared<ktr::linux_::IcuPluralRules>();
    platform->localization = std::make_shared<ktr::linux_::QtLocalization>("ru");
    Platform::install(platform);
    const FormatArguments arguments = {"22"};
    for (auto _ : state) {
        benchmark::DoNotOptimize(formatted(kPlural, arguments));
    }
    Platform::install(nullptr);
}
BENCHMARK(PluralText);

}  // namespace

BENCHMARK_MAIN();
