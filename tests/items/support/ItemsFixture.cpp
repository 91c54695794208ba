#include "tests/items/support/ItemsFixture.h"

#include "host/system/IcuFormatters.h"
#include "host/system/LocalFileCoordinator.h"
#include "host/system/PosixFileSystem.h"
#include "host/system/UnicodeCharacterData.h"
#include "platform/Services.h"
#include "platform/TypeRegistry.h"

#include <algorithm>
#include <cctype>
#include <filesystem>
#include <fstream>

namespace items_tests {

namespace {

struct Type {
    std::string_view extension, identifier, kindOf, description;
};

constexpr Type types[] = {
    {"txt", "public.plain-text", "public.text", "Plain text document"},
    {"png", "public.png", "public.image", "PNG image"},
    {"mp4", "public.mpeg-4", "public.movie", "MPEG-4 film"},
    {"mp3", "public.mp3", "public.audio", "MP3 sound"},
    {"pdf", "public.pdf", "public.data", "PDF document"},
    {"zip", "public.zip-archive", "public.archive", "Zip archive"},
    {"pages", "app.tarrow.pages", "public.package", "Pages document"},
};

/// The few types that these tests speak of, the same on every machine.
class FewTypes : public platform::TypeRegistry {
public:
    std::optional<std::string> typeForExtension(std::string_view extension) const override
    {
        std::string folded(extension);
        std::ranges::transform(folded, folded.begin(), [](unsigned char c) { return std::tolower(c); });
        return text(find(&Type::extension, folded), &Type::identifier);
    }
    bool conformsTo(std::string_view type, std::string_view other) const override
    {
        const auto* known = find(&Type::identifier, type);
        return type == other || (known && known->kindOf == other);
    }
    std::optional<std::string> description(std::string_view type) const override
    {
        return text(find(&Type::identifier, type), &Type::description);
    }
    std::string iconName(std::string_view) const override { return "text-x-generic"; }

private:
    static const Type* find(std::string_view Type::*column, std::string_view value)
    {
        const auto* type = std::ranges::find(types, value, column);
        return type == std::end(types) ? nullptr : type;
    }
    static std::optional<std::string> text(const Type* type, std::string_view Type::*column)
    {
        return type ? std::optional(std::string(type->*column)) : std::nullopt;
    }
};

/// Shows text and PDF documents.
class FewPreviews : public platform::PreviewSupport {
public:
    bool canPreview(const Url& url) const override
    {
        return url.pathExtension() == "pdf" || url.pathExtension() == "txt";
    }
};

} // namespace

ItemsFixture::ItemsFixture()
{
    decorated = std::make_shared<DecoratedCloud>(DriveFixture::cloud);
    coordinator =
        std::make_shared<DecoratedCoordinator>(std::make_shared<host::system::LocalFileCoordinator>());
    platform::ServiceSet set;
    set.characterData = std::make_shared<host::system::UnicodeCharacterData>();
    set.cloudDocumentService = decorated;
    set.dispatch = dispatch;
    set.fileCoordinator = coordinator;
    set.fileSystem = std::make_shared<host::system::PosixFileSystem>();
    set.formatters = std::make_shared<host::system::IcuFormatters>("en_US", "UTC");
    set.localization = texts;
    set.notificationCenter = notifications;
    set.previewSupport = std::make_shared<FewPreviews>();
    set.typeRegistry = std::make_shared<FewTypes>();
    platform::installServices(std::move(set));
}

ItemsFixture::~ItemsFixture()
{
    platform::installServices({});
}

void ItemsFixture::changeValues(std::function<void(const Url&, AttributeMap&)> change)
{
    decorated->decoratedItems.changePromised = [change = std::move(change)](
                                                   const Url& location, Result<AttributeMap>& values) {
        if (values.value)
            change(location, *values.value);
    };
}

Url ItemsFixture::describeContainer(const std::string& identifier, const std::string& description) const
{
    const auto documents = makeContainer(identifier);
    writeFile(layout().containerDescription(identifier), description);
    return documents;
}

Url writeFile(const std::string& path, std::string_view content)
{
    std::filesystem::create_directories(std::filesystem::path(path).parent_path());
    std::ofstream(path, std::ios::binary) << content;
    return Url::fileURL(path);
}

} // namespace items_tests
