-- SPDX-License-Identifier: MIT
-- Links between the pages of the manual, which are written for Markdown, as they are in HTML files
-- of their own or, with the metadata value "together", in one file, where a page is a section whose
-- name is its folder's and its own.
local together = false

local function address(target, folder)
  if target:match("^%a+:") or target:match("^#") then return target end
  if not together then return (target:gsub("%.md$", ".html")) end
  local up, page = target:match("^(%.%./)([^/]+)%.md$")
  if up then return "#docs-" .. page end
  page = target:match("^manual/([^/]+)%.md$")
  if page then return "#manual-" .. page end
  page = target:match("^([^/]+)%.md$")
  return page and "#" .. folder .. "-" .. page or target
end

function Pandoc(document)
  local meta = document.meta
  together = meta.together ~= nil
  local folder = meta.folder and pandoc.utils.stringify(meta.folder) or ""
  return document:walk({
    Link = function(link)
      link.target = address(link.target, folder)
      return link
    end,
  })
end
