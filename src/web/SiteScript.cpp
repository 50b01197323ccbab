#include "web/SiteScript.h"

namespace zorbin {
namespace {

constexpr char Script[] = R"js('use strict';
(function () {
  const box = document.getElementById('search');
  const catalog = document.getElementById('catalog');
  const results = document.getElementById('results');
  const found = document.getElementById('found');
  if (!box || !catalog || !results || !found) return;
  const hidden = [catalog].concat(Array.from(document.querySelectorAll('.sections')));
  const shownAtMost = 60;
  let items = null;
  let loading = false;

  function load() {
    if (items || loading) return;
    loading = true;
    const script = document.createElement('script');
    script.src = 'search-index.js';
    script.onload = function () {
      items = (window.zorbinIndex || []).map(function (entry) {
        return {entry: entry, key: String(entry[0]).toLocaleLowerCase(), name: String(entry[1]).toLocaleLowerCase()};
      });
      show();
    };
    document.head.appendChild(script);
  }

  function page(number) {
    return number === 1 ? 'index.html' : 'page-' + number + '.html';
  }

  function article(entry) {
    const item = document.createElement('article');
    item.className = 'item result';
    const link = document.createElement('a');
    link.href = page(entry[5]) + '#i' + entry[6];
    if (entry[2]) {
      const picture = document.createElement('img');
      picture.src = entry[2];
      picture.width = entry[3];
      picture.height = entry[4];
      picture.alt = entry[1];
      link.appendChild(picture);
    }
    const name = document.createElement('div');
    name.className = 'name';
    name.textContent = entry[1];
    const key = document.createElement('div');
    key.className = 'key';
    key.textContent = entry[0];
    link.appendChild(name);
    link.appendChild(key);
    item.appendChild(link);
    return item;
  }

  function show() {
    const text = box.value.trim().toLocaleLowerCase();
    const searching = text.length > 0;
    hidden.forEach(function (element) { element.hidden = searching; });
    results.hidden = !searching;
    found.hidden = !searching;
    results.replaceChildren();
    if (!searching) return;
    if (!items) {
      found.textContent = 'טוען…';
      load();
      return;
    }
    const matches = items.filter(function (item) {
      return item.key.includes(text) || item.name.includes(text);
    });
    matches.slice(0, shownAtMost).forEach(function (item) { results.appendChild(article(item.entry)); });
    if (matches.length === 0) found.textContent = 'לא נמצאו פריטים';
    else if (matches.length === 1) found.textContent = 'נמצא פריט אחד';
    else if (matches.length <= shownAtMost) found.textContent = 'נמצאו ' + matches.length + ' פריטים';
    else found.textContent = 'מוצגים ' + shownAtMost + ' מתוך ' + matches.length + ' פריטים שנמצאו';
  }

  box.form.hidden = false;
  box.form.addEventListener('submit', function (event) { event.preventDefault(); });
  box.addEventListener('focus', load);
  box.addEventListener('input', show);
  if (box.value) show();
})();
)js";

} // namespace

QByteArrayView siteScript()
{
    return Script;
}

} // namespace zorbin
