// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/repository/TreeReader.h"

#include "host/broker/Types.h"
#include "host/repository/Grammar.h"
#include "host/repository/LiteralReader.h"
#include "host/repository/Words.h"

#include <utility>

namespace Host {

namespace {

using Node = tao::pegtl::parse_tree::node;

// Each function takes its node and reads its
// children in the order in which the rule names them.
class TreeReader {
public:
    explicit TreeReader(const std::shared_ptr<const std::string>& file) : file_(file) {}

    Syntax::Production production(const Node& node) const
    {
        if (node.is_type<Grammar::Pragma>())
            return pragma(node);
        if (node.is_type<Grammar::Class>())
            return classOf(node);
        return qualifierType(node);
    }

private:
    // Walks the children of a node.
    class Cursor {
    public:
        explicit Cursor(const Node& node) : nodes_(node.children) {}

        // The next child when it is of that rule, else null.
        template <typename Rule>
        const Node* take()
        {
            if (at_ == nodes_.size() || !nodes_[at_]->template is_type<Rule>())
                return nullptr;
            return nodes_[at_++].get();
        }
        // The next child, whatever it is; null at the end.
        const Node* take() { return at_ == nodes_.size() ? nullptr : nodes_[at_++].get(); }

    private:
        const Node::children_t& nodes_;
        std::size_t at_ = 0;
    };

    SourcePosition position(const Node& node) const
    {
        const auto& begin = node.m_begin;
        return {file_, static_cast<std::uint32_t>(begin.line),
            static_cast<std::uint32_t>(begin.column)};
    }

    Syntax::Name name(const Node& node) const { return {node.string(), position(node)}; }

    std::string text(const Node& node) const
    {
        std::vector<QuotedText> pieces;
        for (const auto& piece : node.children)
            pieces.push_back({piece->string_view(), position(*piece)});
        return readText(pieces);
    }

    Syntax::Integer integer(
        const Node& node, unsigned base, std::size_t prefix, std::size_t suffix) const
    {
        const std::string_view written = node.string_view();
        const bool hasSign = written.front() == '+' || written.front() == '-';
        const std::size_t begin = (hasSign ? 1 : 0) + prefix;
        std::string digits(written.substr(0, hasSign ? 1 : 0));
        digits += written.substr(begin, written.size() - begin - suffix);
        return readInteger(digits, base, position(node));
    }

    Syntax::Literal literal(const Node& node) const
    {
        Syntax::Literal literal;
        literal.position = position(node);
        if (node.is_type<Grammar::Text>())
            literal.value = text(node);
        else if (node.is_type<Grammar::OneCharacter>())
            literal.value = readCharacter({node.string_view(), literal.position});
        else if (node.is_type<Grammar::Real>())
            literal.value = readReal(node.string_view(), literal.position);
        else if (node.is_type<Grammar::Hexadecimal>())
            literal.value = integer(node, 16, 2, 0);
        else if (node.is_type<Grammar::Binary>())
            literal.value = integer(node, 2, 0, 1);
        else if (node.is_type<Grammar::Octal>())
            literal.value = integer(node, 8, 1, 0);
        else if (node.is_type<Grammar::Decimal>())
            literal.value = integer(node, 10, 0, 0);
        else if (node.is_type<Grammar::True>())
            literal.value = true;
        else if (node.is_type<Grammar::False>())
            literal.value = false;
        return literal;
    }

    std::optional<Syntax::Initializer> initializer(const Node* node) const
    {
        if (node == nullptr)
            return std::nullopt;
        Syntax::Initializer value;
        value.position = position(*node);
        value.isArray = node->is_type<Grammar::List>();
        if (value.isArray)
            for (const auto& element : node->children)
                value.elements.push_back(literal(*element));
        else
            value.elements.push_back(literal(*node));
        return value;
    }

    Syntax::Type type(Cursor& children) const
    {
        const Node& node = *children.take();
        Syntax::Type type;
        type.position = position(node);
        if (node.is_type<Grammar::DataType>()) {
            type.code = dataTypeNamed(node.string_view());
        } else {
            type.code = CMPI_ref;
            type.referenceClass = node.string();
        }
        return type;
    }

    void array(Cursor& children, Syntax::Type& type) const
    {
        const Node* const suffix = children.take<Grammar::Array>();
        if (suffix == nullptr)
            return;
        type.code = arrayOf(type.code);
        if (!suffix->children.empty()) {
            const Node& size = *suffix->children.front();
            type.arraySize = readArraySize(size.string_view(), position(size));
        }
    }

    std::vector<Syntax::FlavorWord> flavors(Cursor& children) const
    {
        std::vector<Syntax::FlavorWord> words;
        while (const Node* const word = children.take<Grammar::FlavorWord>())
            words.push_back({flavorNamed(word->string_view()), position(*word)});
        return words;
    }

    Syntax::Qualifier qualifier(const Node& node) const
    {
        Cursor children(node);
        Syntax::Qualifier qualifier;
        qualifier.name = name(*children.take<Grammar::QualifierName>());
        qualifier.flavors = flavors(children);
        if (qualifier.flavors.empty()) {
            qualifier.value = initializer(children.take());
            qualifier.flavors = flavors(children);
        }
        return qualifier;
    }

    std::vector<Syntax::Qualifier> qualifiers(Cursor& children) const
    {
        std::vector<Syntax::Qualifier> list;
        while (const Node* const node = children.take<Grammar::Qualifier>())
            list.push_back(qualifier(*node));
        return list;
    }

    Syntax::QualifierType qualifierType(const Node& node) const
    {
        Cursor children(node);
        Syntax::QualifierType declared;
        declared.name = name(*children.take<Grammar::QualifierName>());
        declared.type = type(children);
        array(children, declared.type);
        const Node* scope = children.take<Grammar::ScopeWord>();
        if (scope == nullptr) {
            declared.value = initializer(children.take());
            scope = children.take<Grammar::ScopeWord>();
        }
        for (; scope != nullptr; scope = children.take<Grammar::ScopeWord>())
            declared.scopes.add(scopeNamed(scope->string_view()));
        declared.flavors = flavors(children);
        return declared;
    }

    std::vector<Syntax::Parameter> parameters(const Node& list) const
    {
        std::vector<Syntax::Parameter> parameters;
        for (const auto& node : list.children) {
            Cursor children(*node);
            Syntax::Parameter& parameter = parameters.emplace_back();
            parameter.qualifiers = qualifiers(children);
            parameter.type = type(children);
            parameter.name = name(*children.take<Grammar::ParameterName>());
            array(children, parameter.type);
        }
        return parameters;
    }

    void feature(const Node& node, Syntax::Class& declared) const
    {
        Cursor children(node);
        Syntax::Property feature;
        feature.qualifiers = qualifiers(children);
        feature.type = type(children);
        feature.name = name(*children.take<Grammar::FeatureName>());
        if (const Node* const list = children.take<Grammar::Parameters>()) {
            declared.methods.push_back({std::move(feature.qualifiers), std::move(feature.type),
                std::move(feature.name), parameters(*list)});
            return;
        }
        array(children, feature.type);
        feature.value = initializer(children.take());
        declared.properties.push_back(std::move(feature));
    }

    Syntax::Class classOf(const Node& node) const
    {
        Cursor children(node);
        Syntax::Class declared;
        declared.qualifiers = qualifiers(children);
        declared.name = name(*children.take<Grammar::ClassName>());
        if (const Node* const superclass = children.take<Grammar::Superclass>())
            declared.superclass = name(*superclass);
        while (const Node* const next = children.take<Grammar::Feature>())
            feature(*next, declared);
        return declared;
    }

    Syntax::Pragma pragma(const Node& node) const
    {
        Cursor children(node);
        const Syntax::Name pragmaName = name(*children.take<Grammar::PragmaName>());
        const Node& argument = *children.take<Grammar::PragmaText>();
        return {pragmaName, text(argument), position(argument)};
    }

    const std::shared_ptr<const std::string>& file_;
};

} // namespace

Syntax::Production readProduction(const Node& node, const std::shared_ptr<const std::string>& file)
{
    return TreeReader(file).production(node);
}

} // namespace Host
