#pragma once

#include "console/Output.h"
#include "explaining/ExplainCommand.h"
#include "host/DirectoryResources.h"
#include "tests/doubles/Files.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <vector>

namespace pallax::doubles {

/// Asks questions in a folder with the names of a few networks.
class ExplainFixture : public testing::Test {
protected:
    ExplainFixture() {
        write("data/mobile-broadband-provider-info/serviceproviders.xml", R"(<serviceproviders>
<country code="de"><name>Germany</name>
<provider><name>Shop</name><gsm><network-id mcc="262" mnc="01"/></gsm></provider>
<provider primary="true"><name>Owner</name><gsm><network-id mcc="262" mnc="01"/></gsm></provider>
</country>
<country code="gg"><provider><name>Sure</name>
<gsm><network-id mcc="234" mnc="55"/></gsm></provider></country>
<country code="im"><provider><name>Sure</name>
<gsm><network-id mcc="234" mnc="55"/></gsm></provider></country>
</serviceproviders>)");
        write("data/xml/iso-codes/iso_3166-1.xml", R"(<iso_3166_entries>
<iso_3166_entry alpha_2_code="DE" name="Germany"/>
<iso_3166_entry alpha_2_code="FR" name="France"/>
</iso_3166_entries>)");
    }

    std::string write(const std::string& name, const std::string& content) {
        std::filesystem::create_directories(std::filesystem::path(folder.path(name)).parent_path());
        return folder.write(name, content);
    }

    AnswersResult ask(const std::vector<std::string>& words) {
        return explain(words, {resources, {folder.path("data")}, folder.path("profiles"), profile});
    }

    /// The answers as they are printed, or the status and the sentence of a refusal.
    std::string told(const std::vector<std::string>& words, bool asJson = false) {
        const AnswersResult result = ask(words);
        if (!result) {
            return std::to_string(result.error().status) + ": " + result.error().sentence;
        }
        notes = result->notes;
        std::string text;
        Output output([&text](std::string_view block) { text += block; });
        (asJson ? writeAsJson : writeAsText)(result->answers, output);
        output.flush();
        return text;
    }
    std::string json(const std::vector<std::string>& words) { return told(words, true); }

    TemporaryFolder folder;
    DirectoryResources resources{PALLAX_SOURCE_DIR "/resources"};
    std::string profile{kDefaultProfile};
    std::vector<std::string> notes; ///< of the question asked last
};

} // namespace pallax::doubles
