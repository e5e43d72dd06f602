#pragma once

#include "LogGenerator/Template/RecordSection.h"

namespace spectrel {

/// "Reselection Candidates List", code 0xB186: a list of the cells of every radio technology that the phone could move
/// to, with the priority of each. Every record of the code rebuilds it.
class ReselectionCandidatesList final : public RecordSection {
public:
    ReselectionCandidatesList(ClassDictionary& dict, CodeDictionary& codeDict);

private:
    void decode(RecordView record) override;
};

} // namespace spectrel
