#pragma once

#include "LogGenerator/Template/RecordSection.h"

namespace spectrel {

/// "Reselection Candidates", code 0xB186: the cell that the phone would leave.
class ReselectionCandidatesMisc final : public RecordSection {
public:
    ReselectionCandidatesMisc(ClassDictionary& dict, CodeDictionary& codeDict);

private:
    void decode(RecordView record) override;
};

} // namespace spectrel
