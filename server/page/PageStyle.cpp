#include "server/page/PageStyle.h"

#include <openssl/evp.h>
#include <openssl/sha.h>

#include <array>
#include <cstdio>
#include <string>

#include "platform/contacts/PersonColor.h"

namespace ktr::server {

namespace {

constexpr std::string_view kSheet = R"css(
:root{color-scheme:light dark;--window:#F5F1E9;--card:#FFFDF8;--cardEdge:transparent;--bubble:#DCE7DC;--highlight:#E3ECE3;
--ink:#2B2620;--inkSoft:#635A4E;--pine:#1E6653;--onPine:#FFFFFF;--fieldLine:#8A8478;--warning:#A52A20;--separator:#979E95;
--shadow:0 1px 2px rgba(70,52,26,.1),0 8px 24px -6px rgba(70,52,26,.1);--ring:2px}
@media (prefers-color-scheme:dark){:root{--window:#1B1916;--card:#2E2A25;--cardEdge:#3B362F;--bubble:#2F4239;
--highlight:#37443D;--ink:#F2ECE1;--inkSoft:#BFB5A7;--pine:#86CDB5;--onPine:#10251E;--fieldLine:#857D72;--warning:#FF9C8F;
--shadow:0 0 transparent}}
@media (prefers-contrast:more){:root{--window:#FFF;--card:#FFF;--cardEdge:#000;--bubble:#FFF;--highlight:#FFF;--ink:#000;
--inkSoft:#2B2620;--pine:#0B4536;--fieldLine:#000;--warning:#7F150D;--separator:#000;--shadow:0 0 transparent;--ring:3px}}
@media (prefers-contrast:more) and (prefers-color-scheme:dark){:root{--window:#000;--card:#000;--cardEdge:#FFF;--bubble:#000;
--highlight:#000;--ink:#FFF;--inkSoft:#E9E2D6;--pine:#B6F0DC;--onPine:#000;--fieldLine:#FFF;--warning:#FFC3BA;
--separator:#FFF}}
*{box-sizing:border-box}
html{-webkit-text-size-adjust:100%;text-size-adjust:100%}
body{margin:0;background:var(--window);color:var(--ink);font:1rem/1.362 "Noto Sans",system-ui,sans-serif;
overflow-wrap:anywhere}
main{max-width:424px;margin:0 auto;padding:0 12px 40px}
h1,h2,p,ul,ol,dl,dd,fieldset,legend{margin:0;padding:0;border:0;font-size:inherit}
ul,ol{list-style:none}
a{color:inherit}
:focus-visible{outline:var(--ring) solid var(--pine);outline-offset:2px;border-radius:17px}
.brand{display:flex;align-items:center;gap:12px;padding:24px 15px 0;color:var(--inkSoft)}
.brand svg{flex:none}
h1{font-size:1.5rem;text-wrap:balance;padding:10px 15px 12px}
.bar{display:flex;align-items:center;min-height:56px}
.bar a{flex:none;display:grid;place-items:center;width:44px;height:44px;color:var(--pine)}
.bar h1{font-size:1rem;padding:0 11px}
h2,legend{font-size:.8125rem;font-weight:400;color:var(--inkSoft);padding:22px 15px 8px}
.card{background:var(--card);border-radius:20px;box-shadow:var(--shadow),inset 0 0 0 1px var(--cardEdge);overflow:hidden}
.apart,.card+.card,form+.card,.card+form{margin-top:16px}
.row{display:flex;align-items:center;gap:12px;width:100%;min-height:53px;padding:8px 15px;text-decoration:none;color:inherit;
background:none;border:0;font:inherit;text-align:start;position:relative}
.row+.row,li+li>.row,li+li>form>.row,ul+.row,.ruled{border-top:1px solid var(--separator)}
a.row:hover,button.row:hover{background:var(--highlight)}
a.row:active,button.row:active{background-image:linear-gradient(rgba(0,0,0,.2),rgba(0,0,0,.2))}
.row:focus-visible{outline-offset:-3px}
.row>.grow{flex:1;min-width:0}
.row>svg{flex:none;color:var(--pine)}
.person{min-height:66px;gap:19px;padding-inline-start:21px}
.name,.strong{font-weight:700;display:block}
.soft{display:block;font-size:.8125rem;color:var(--inkSoft)}
.face{flex:none;display:grid;place-items:center;width:42px;height:42px;border-radius:50%;color:#FFF;font-weight:700;
font-size:1.1875rem;line-height:1}
.large .face{width:54px;height:54px;font-size:1.375rem}
.large{min-height:78px;padding-inline-start:15px;gap:13px}
.action{color:var(--pine);font-weight:700}
.looks{padding:8px 0}
.looks li{display:flex;flex-wrap:wrap;justify-content:space-between;gap:0 12px;padding:4px 15px;min-height:34px;
align-items:center}
.looks time{font-size:.8125rem;color:var(--inkSoft)}
.switch{flex:none;position:relative;width:48px;height:28px;border-radius:14px;border:2px solid var(--fieldLine);
background:none;appearance:none;margin:0}
.switch::after{content:"";position:absolute;top:4px;inset-inline-start:4px;width:16px;height:16px;border-radius:50%;
background:var(--fieldLine)}
.switch.on,.switch:checked{background:var(--pine);border-color:var(--pine)}
.switch.on::after,.switch:checked::after{inset-inline-start:auto;inset-inline-end:1px;top:1px;width:22px;height:22px;
background:var(--onPine)}
.choice{min-height:46px;gap:15px;padding-block:1px}
.choice+.choice{border:0}
input[type=radio]{appearance:none;flex:none;width:21px;height:21px;margin:0;border-radius:50%;border:2px solid var(--fieldLine);
background:none}
input[type=radio]:checked{border-color:var(--pine);background:radial-gradient(circle,var(--pine) 0 5px,transparent 5.5px)}
.choice label{flex:1;min-width:0;display:flex;align-items:center;min-height:44px}
select,input[type=text],input[type=time],input[type=number]{min-height:44px;border:1px solid var(--fieldLine);border-radius:12px;
background:var(--card);color:var(--ink);font:inherit;padding:4px 12px;max-width:100%}
.choice select,.choice input[type=time]{flex:none;width:128px;min-width:0;margin-block:6px}
.field{display:block;padding:11px 15px}
.field+.field{border-top:1px solid var(--separator)}
.field label,.field dt{display:block;font-size:.8125rem;color:var(--inkSoft)}
.field dd{font-family:"Noto Sans Mono",ui-monospace,monospace;font-size:.9375rem;line-height:22px;user-select:all;
overflow-wrap:anywhere}
.field select,.field input{width:100%;margin-top:4px}
.main,.quiet,.outlined{display:block;width:100%;min-height:48px;padding:8px 24px;border-radius:24px;border:0;font:inherit;
font-weight:700;text-align:center;text-decoration:none;background:none;color:var(--ink)}
.main{background:var(--pine);color:var(--onPine)}
.outlined{border:1px solid var(--fieldLine);background:var(--card);color:var(--pine)}
a.outlined,a.main,a.quiet{display:grid;place-items:center}
.main:focus-visible,.quiet:focus-visible,.outlined:focus-visible{border-radius:24px}
.buttons{margin-top:22px}
.buttons>*+*,.buttons form+form{margin-top:8px}
.words{padding:0 15px}
.words+.words{padding-top:10px}
.note{padding:8px 15px 0;font-size:.8125rem;color:var(--inkSoft)}
.told{display:flex;gap:10px;margin:12px 0;padding:12px 15px;border-radius:20px;background:var(--bubble)}
.warn{display:flex;gap:8px;padding:8px 15px 0;font-size:.8125rem}
.warn svg,.told svg{flex:none;margin-top:2px;color:var(--warning)}
.steps>li{display:grid;grid-template-columns:26px minmax(0,1fr);column-gap:14px;padding:8px 15px}
.steps .disc{display:grid;place-items:center;width:26px;height:26px;border-radius:50%;background:var(--bubble);
font-weight:700;font-size:.8125rem}
.steps>li>.wide{grid-column:1/-1;margin:10px -15px 0}
.code{display:grid;place-items:center;width:204px;height:204px;margin:14px auto 0;background:#FFF;border-radius:20px;
box-shadow:var(--shadow)}
.beside{display:inline-flex;align-items:center;gap:8px}
.second{grid-column:2;padding-top:6px}
.field dd.plain{font:inherit}
.note.value{font-family:"Noto Sans Mono",ui-monospace,monospace;user-select:all}
.apart-far{margin-top:32px}
.end{flex:none;min-height:44px;min-width:44px;padding:0 14px;border-radius:22px;border:1px solid var(--fieldLine);color:var(--ink);
text-decoration:none;display:grid;place-items:center;font:inherit;font-weight:700;background:none}
.unseen{position:absolute;width:1px;height:1px;overflow:hidden;clip-path:inset(50%);white-space:nowrap}
[dir=rtl] .flip{transform:scaleX(-1)}
@media (forced-colors:active){.face{border:1px solid}.switch::after{background:ButtonText}
.switch.on::after,.switch:checked::after{background:Highlight}input[type=radio]{appearance:auto}}
)css";

std::string colorsOfFaces() {
    std::string rules;
    for (std::size_t number = 0; number < platform::PersonColor::kCount; ++number) {
        std::array<char, 40> rule{};
        std::snprintf(rule.data(), rule.size(), ".c%zu{background:#%06X}", number, platform::PersonColor::rgb(number));
        rules += rule.data();
    }
    return rules;
}

}  // namespace

std::string_view PageStyle::sheet() {
    static const std::string kWithFaces = std::string(kSheet) + colorsOfFaces();
    return kWithFaces;
}

std::string_view PageStyle::policy() {
    static const std::string kPolicy = [] {
        std::array<unsigned char, SHA256_DIGEST_LENGTH> hash{};
        SHA256(reinterpret_cast<const unsigned char*>(sheet().data()), sheet().size(), hash.data());
        std::array<unsigned char, 64> text{};
        const int length = EVP_EncodeBlock(text.data(), hash.data(), static_cast<int>(hash.size()));
        return "default-src 'none'; style-src 'sha256-" +
               std::string(reinterpret_cast<const char*>(text.data()), static_cast<std::size_t>(length)) +
               "'; form-action 'self'; frame-ancestors 'none'; base-uri 'none'";
    }();
    return kPolicy;
}

}  // namespace ktr::server
