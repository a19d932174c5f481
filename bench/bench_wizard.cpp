// Cost of the wizard's work on design data: the batch run of each sample
// target, the finish routine on a block with many pins, bonded-instance
// generation at the family maximum, and load, save and batch run of design
// data scaled up to show how the cost grows.

#include "Qvz_DesignJson.h"
#include "Qvz_MGTRCB.h"
#include "Qvz_MGTWizMain.h"
#include "Qvz_Messages.h"
#include "Qvz_WizData.h"
#include "Qvz_WizPage.h"

#include <QCoreApplication>
#include <QFile>
#include <QString>

#include <benchmark/benchmark.h>

#include <cstdio>
#include <cstdlib>
#include <memory>
#include <string>
#include <type_traits>
#include <utility>
#include <vector>

namespace {

const char* const kTargetNames[] = {"gt", "gt10", "gt11"};
constexpr int kTargetCount = 3;

const Qvz_WizData& Target(int i) {
    static std::vector<Qvz_WizData> targets = [] {
        std::vector<Qvz_WizData> loaded(kTargetCount);
        for (int t = 0; t < kTargetCount; ++t) {
            QString error;
            const QString path = QString(VELOMUX_TARGETS) + "/" + kTargetNames[t] + ".json";
            if (!Qvz_DesignJson::LoadFile(path, loaded[std::size_t(t)], error)) {
                std::fprintf(stderr, "velomux_bench: %s\n", qPrintable(error));
                std::exit(1);
            }
        }
        return loaded;
    }();
    return targets[std::size_t(i)];
}

std::size_t PinCount(const Qvz_WizData& d) {
    std::size_t n = 0;
    for (const auto& b : d.GetBlocks())
        n += b->GetPins().size();
    return n;
}

// A wizard set up for a batch run over data, with its messages kept.
struct BatchWizard {
    Qvz_RecordingSink sink;
    Qvz_MGTWizMain wiz{"Velomux Wizard", false};
    explicit BatchWizard(Qvz_WizData& data) {
        wiz.SetWizData(&data);
        wiz.SetMessageSink(&sink);
        wiz.SetRunMode(Qvz_RunMode::Batch);
    }
    // The pages' batch steps without the finish; false when one refuses.
    bool RunPages() {
        wiz.Prepare();
        for (int i = 0; i < Qvz_WizMain::kMaxPages && wiz.GetPage(i); ++i)
            if (!wiz.GetPage(i)->DoBatchPage())
                return false;
        return true;
    }
};

// A fresh copy of the design data and a wizard over it for each iteration;
// the previous ones are destroyed here, while the timing is paused, rather
// than at the end of the timed iteration. They go before the copy is made,
// so that the allocator settles what they freed while making the copy, not
// in the first timed allocation after it.
struct Fresh {
    std::unique_ptr<BatchWizard> run;
    std::unique_ptr<Qvz_WizData> data;
    BatchWizard& Make(const Qvz_WizData& base) {
        run.reset();
        data.reset();
        data = std::make_unique<Qvz_WizData>(base);
        run = std::make_unique<BatchWizard>(*data);
        return *run;
    }
};

const char* Outcome(int result) {
    return result == Qvz_RunCompleted ? "completed" : "refused";
}

int ActiveFamilyMax(const Qvz_WizData& d) {
    const Qvz_Block* b = d.GetActiveBlock();
    if (!b)
        return 0;
    const Qvz_Target& t = d.Target();
    return b->SupportsMGT3() ? t.maxBondGT : b->SupportsMGT10() ? t.maxBondGT10 : t.maxBondGT11;
}

// ------------------------------------------------------------- sample targets

// A run works on its own copy, as the host's run works on freshly loaded data;
// BM_CopyDesign gives the share of that copy.
void BM_BatchRun(benchmark::State& state) {
    const Qvz_WizData& base = Target(int(state.range(0)));
    int result = 0;
    for (auto _ : state) {
        Qvz_WizData data = base;
        BatchWizard run(data);
        result = run.wiz.Run();
        benchmark::DoNotOptimize(result);
    }
    state.SetLabel(std::string(kTargetNames[state.range(0)]) + " " + Outcome(result));
}
BENCHMARK(BM_BatchRun)->DenseRange(0, kTargetCount - 1)->Unit(benchmark::kMicrosecond);

void BM_CopyDesign(benchmark::State& state) {
    const Qvz_WizData& base = Target(int(state.range(0)));
    for (auto _ : state) {
        Qvz_WizData data = base;
        benchmark::DoNotOptimize(data.GetBlocks().data());
    }
    state.SetLabel(kTargetNames[state.range(0)]);
}
BENCHMARK(BM_CopyDesign)->DenseRange(0, kTargetCount - 1)->Unit(benchmark::kMicrosecond);

// ------------------------------------------------------ finish on many pins

// The gt10 target with n more pins on its active block, of every kind the
// finish routine tells apart: inputs and outputs, single bits and buses,
// data-width pins, tied pins.
Qvz_WizData ManyPins(int n) {
    Qvz_WizData d = Target(1);
    Qvz_Block* b = d.GetActiveBlock();
    for (int i = 0; i < n; ++i) {
        Qvz_Pin* p = b->AddPin(("XPIN" + std::to_string(i)).c_str(), i % 2 ? "OUT" : "IN");
        p->SetWidth(1 << (i % 6));
        p->SetSupportsDataWidth(i % 3 == 0);
        if (i % 7 == 0)
            p->SetIsGrounded(true);
    }
    return d;
}

void BM_FinishManyPins(benchmark::State& state) {
    const Qvz_WizData base = ManyPins(int(state.range(0)));
    int result = 0;
    Fresh fresh;
    for (auto _ : state) {
        state.PauseTiming();
        BatchWizard& run = fresh.Make(base);
        const bool pagesOk = run.RunPages();
        state.ResumeTiming();
        result = pagesOk ? run.wiz.FinishRun() : Qvz_RunRefused;
        benchmark::DoNotOptimize(result);
    }
    state.counters["pins"] = double(base.GetActiveBlock()->GetPins().size());
    state.SetComplexityN(state.range(0));
    state.SetLabel(result == 0 ? "finished" : "pages refused");
}
BENCHMARK(BM_FinishManyPins)
    ->RangeMultiplier(8)
    ->Range(8, 4096)
    ->Complexity(benchmark::oN)
    ->Unit(benchmark::kMicrosecond);

// ------------------------------------------- bonded instances at the maximum

// The channel-bonding page grows its generation of bonded copies in its own
// time; until it has one, what exists is measured instead: one CopyBlock of
// the active block per bonded transceiver, the base operation each copy
// rests on.
template <typename Page, typename = void> struct HasBondedGeneration : std::false_type {};
template <typename Page>
struct HasBondedGeneration<Page, std::void_t<decltype(std::declval<Page&>().GenerateBondedInstances(
                                     std::declval<Qvz_Block*>(), false, 0))>> : std::true_type {};

template <typename Page>
void GenerateBonded(Page* page, Qvz_WizData& data, Qvz_Block* block, int n) {
    if constexpr (HasBondedGeneration<Page>::value) {
        (void)data;
        page->GenerateBondedInstances(block, false, n);
    } else {
        (void)page;
        for (int i = 1; i <= n; ++i)
            data.CopyBlock(block, (block->GetName().str() + "_BOND" + std::to_string(i)).c_str());
    }
}

void BM_BondedInstances(benchmark::State& state) {
    const Qvz_WizData& base = Target(int(state.range(0)));
    const int n = ActiveFamilyMax(base);
    std::size_t blocksAfter = 0;
    Fresh fresh;
    for (auto _ : state) {
        state.PauseTiming();
        BatchWizard& run = fresh.Make(base);
        Qvz_WizData& data = *fresh.data;
        Qvz_Block* block = data.GetActiveBlock();
        if (block && block->GetNamedAttribute("QVZ_CHAN_BOND_NUMBER"))
            block->SetAttributeValue("QVZ_CHAN_BOND_NUMBER", std::to_string(n).c_str());
        run.RunPages();
        auto* page = static_cast<Qvz_MGTRCB*>(run.wiz.GetPage(Qvz_MGTWizMain::kChannelBonding));
        state.ResumeTiming();
        GenerateBonded(page, data, data.GetActiveBlock(), n);
        blocksAfter = data.GetBlocks().size();
    }
    state.counters["max_bond"] = n;
    state.counters["blocks_after"] = double(blocksAfter);
    state.SetLabel(std::string(kTargetNames[state.range(0)]) +
                   (HasBondedGeneration<Qvz_MGTRCB>::value ? " GenerateBondedInstances"
                                                           : " CopyBlock per bonded copy"));
}
BENCHMARK(BM_BondedInstances)->DenseRange(0, kTargetCount - 1)->Unit(benchmark::kMicrosecond);

// --------------------------------------------------------------- scaled data

// The largest sample target (by blocks, pins and signals) with one signal per
// pin, as a finished design carries, repeated factor times: the copies are
// inactive blocks and signals of their own names.
Qvz_WizData Scaled(int factor) {
    int largest = 0;
    std::size_t size = 0;
    for (int t = 0; t < kTargetCount; ++t) {
        const std::size_t s =
            Target(t).GetBlocks().size() + PinCount(Target(t)) + Target(t).GetSignals().size();
        if (s > size) {
            size = s;
            largest = t;
        }
    }
    const Qvz_WizData& unit = Target(largest);
    Qvz_WizData d = unit;
    for (int k = 0; k < factor; ++k) {
        const std::string suffix = k == 0 ? std::string() : "_X" + std::to_string(k);
        for (const auto& b : unit.GetBlocks()) {
            Qvz_Block* copy = b.get();
            if (k > 0) {
                copy = d.CopyBlock(d.GetNamedBlock(b->GetName()),
                                   (b->GetName().str() + suffix).c_str());
                copy->SetIsUsed(false);
            }
            for (const auto& p : copy->GetPins()) {
                auto s = std::make_unique<Qvz_Signal>(
                    (copy->GetName().str() + "_" + p->GetName().str()).c_str());
                s->SetIsBus(p->GetWidth() > 1, p->GetWidth());
                d.AppendNewSignal(std::move(s));
            }
        }
        for (const auto& s : unit.GetSignals()) {
            if (k == 0)
                continue;
            auto copy = std::make_unique<Qvz_Signal>(*s);
            copy->SetName((s->GetName().str() + suffix).c_str());
            d.AppendNewSignal(std::move(copy));
        }
    }
    // Loaded design data has its names indexed (the reader looks every name
    // up); so does this.
    (void)d.GetNamedSignal(Port::StringBase());
    return d;
}

const Qvz_WizData& ScaledCached(int factor) {
    static std::vector<std::pair<int, Qvz_WizData>> cache;
    for (const auto& [f, d] : cache)
        if (f == factor)
            return d;
    cache.emplace_back(factor, Scaled(factor));
    return cache.back().second;
}

void SizeCounters(benchmark::State& state, const Qvz_WizData& d) {
    state.counters["blocks"] = double(d.GetBlocks().size());
    state.counters["pins"] = double(PinCount(d));
    state.counters["signals"] = double(d.GetSignals().size());
    state.SetComplexityN(state.range(0));
}

void BM_ScaledLoad(benchmark::State& state) {
    const QByteArray text = Qvz_DesignJson::Save(ScaledCached(int(state.range(0))));
    for (auto _ : state) {
        Qvz_WizData d;
        QString error;
        if (!Qvz_DesignJson::Load(text, "scaled", d, error))
            state.SkipWithError(qPrintable(error));
        benchmark::DoNotOptimize(d.GetBlocks().data());
    }
    state.SetBytesProcessed(int64_t(state.iterations()) * text.size());
    SizeCounters(state, ScaledCached(int(state.range(0))));
}

void BM_ScaledSave(benchmark::State& state) {
    const Qvz_WizData& d = ScaledCached(int(state.range(0)));
    qsizetype bytes = 0;
    for (auto _ : state) {
        const QByteArray text = Qvz_DesignJson::Save(d);
        bytes = text.size();
        benchmark::DoNotOptimize(text.constData());
    }
    state.SetBytesProcessed(int64_t(state.iterations()) * bytes);
    SizeCounters(state, d);
}

void BM_ScaledBatchRun(benchmark::State& state) {
    const Qvz_WizData& base = ScaledCached(int(state.range(0)));
    int result = 0;
    Fresh fresh;
    for (auto _ : state) {
        state.PauseTiming();
        BatchWizard& run = fresh.Make(base);
        state.ResumeTiming();
        result = run.wiz.Run();
        benchmark::DoNotOptimize(result);
    }
    SizeCounters(state, base);
    state.SetLabel(Outcome(result));
}

#define VELOMUX_SCALED(bm)                                                                         \
    BENCHMARK(bm)                                                                                  \
        ->Arg(1)                                                                                   \
        ->Arg(10)                                                                                  \
        ->Arg(100)                                                                                 \
        ->Arg(1000)                                                                                \
        ->Complexity(benchmark::oN)                                                                \
        ->Unit(benchmark::kMillisecond)
VELOMUX_SCALED(BM_ScaledLoad);
VELOMUX_SCALED(BM_ScaledSave);
VELOMUX_SCALED(BM_ScaledBatchRun);

} // namespace

// --write-scaled DIR: writes the scaled designs as scaled-N.json files, so
// that scripts/bench-floor.sh can run the program on them.
int WriteScaled(const QString& dir) {
    for (int factor : {1, 10, 100, 1000}) {
        QFile f(QString("%1/scaled-%2.json").arg(dir).arg(factor));
        const QByteArray text = Qvz_DesignJson::Save(Scaled(factor));
        if (!f.open(QIODevice::WriteOnly) || f.write(text) != text.size()) {
            std::fprintf(stderr, "velomux_bench: %s: %s\n", qPrintable(f.fileName()),
                         qPrintable(f.errorString()));
            return 1;
        }
    }
    return 0;
}

int main(int argc, char** argv) {
    // As in the host's batch runs: a core application, no display.
    QCoreApplication app(argc, argv);
    if (argc == 3 && std::string(argv[1]) == "--write-scaled")
        return WriteScaled(QString::fromLocal8Bit(argv[2]));
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv))
        return 1;
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}
