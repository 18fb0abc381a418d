#include "app/editor/TimeForm.h"

#include <QFormLayout>
#include <utility>

namespace plume {

TimeForm::TimeForm(ChipFormServices services, const std::shared_ptr<SnippetTimeVariable>& variable)
    : DateTimeForm(tr("Time"), std::move(services), variable, DateTextKind::TimeOnly) {
    addFormatRows();
    rows().addRow(tr("Added:"), makeRow({makeOffset(variable->hour, tr("Hours:"), tr("Hours added")),
                                         makeOffset(variable->minute, tr("Minutes:"), tr("Minutes added")),
                                         makeOffset(variable->second, tr("Seconds:"), tr("Seconds added"))}));
    addLocaleRow();
    addOptionalRow();
}

}  // namespace plume
