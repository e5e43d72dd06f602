#pragma once

#include "Telephony/Modem/ModemService.h"

#include <deque>
#include <utility>

namespace spectrel {

/// Modems within one test: facts are set, wishes are counted, and answered when the test says so, or at once.
class FakeModemService final : public ModemService {
public:
    /// What outlives the source, which owns the service.
    struct Ledger {
        bool isRunning = true;
        std::vector<ModemFacts> modems;
        ModemOutcome cellsOutcome = ModemOutcome::Done;
        std::vector<CellFacts> cells;
        ModemOutcome locationOutcome = ModemOutcome::Done;
        std::optional<LocationFacts> location;
        ModemOutcome rateOutcome = ModemOutcome::Done;
        bool isSlow = false; // answers wait in `answers`
        std::deque<std::function<void()>> answers;
        int cellsAsked = 0;
        int locationsAsked = 0;
        std::vector<std::pair<std::string, std::uint32_t>> rates; // modem and seconds
        ChangeHandler changeHandler;

        void change()
        {
            if (changeHandler)
                changeHandler();
        }
        void answer(std::function<void()> job)
        {
            if (isSlow)
                answers.push_back(std::move(job));
            else
                job();
        }
        void answerAll()
        {
            while (!answers.empty()) {
                const auto job = std::move(answers.front());
                answers.pop_front();
                job();
            }
        }
    };

    explicit FakeModemService(Ledger& ledger)
        : _ledger(ledger)
    {
    }

    void setChangeHandler(ChangeHandler handler) override
    {
        _ledger.changeHandler = std::move(handler);
    }
    bool isRunning() const override
    {
        return _ledger.isRunning;
    }
    std::vector<ModemFacts> modems() const override
    {
        return _ledger.modems;
    }
    void listCells(const std::string&, CellsHandler handler) override
    {
        ++_ledger.cellsAsked;
        const bool isDone = _ledger.cellsOutcome == ModemOutcome::Done;
        _ledger.answer([handler = std::move(handler), outcome = _ledger.cellsOutcome,
                           cells = isDone ? _ledger.cells : std::vector<CellFacts>()] { handler(outcome, cells); });
    }
    void locate(const std::string&, LocationHandler handler) override
    {
        ++_ledger.locationsAsked;
        _ledger.answer([handler = std::move(handler), outcome = _ledger.locationOutcome, location = _ledger.location] {
            handler(outcome, location);
        });
    }
    void setSignalRate(const std::string& modem, std::uint32_t seconds, OutcomeHandler handler) override
    {
        _ledger.rates.emplace_back(modem, seconds);
        for (ModemFacts& facts : _ledger.modems) {
            if (facts.id == modem && _ledger.rateOutcome == ModemOutcome::Done)
                facts.signalRate = seconds;
        }
        _ledger.answer([handler = std::move(handler), outcome = _ledger.rateOutcome] { handler(outcome); });
    }

private:
    Ledger& _ledger;
};

} // namespace spectrel
