// What happens in a form's page: the user's doings are told to the program around it, and its answers are shown. It
// decides nothing. All of this stands in one function: the page itself can call only what is put on the window below.

const fields = new Map();  // by index: what the page holds of a field
const namesakes = new Map();  // by name: the fields that are typed into and move together
const letters = new Map();  // by letter or digit: the box that it ticks together with Alt
let host = null;
let edited = null;  // the field that is typed into, and not left since
let armed = null;  // the pop-up menu in which Return has gone down
let isLoaded = false;
let isShown = false;

// ---- To the program ----

function accept() {
    if (edited) tellValue(edited);
    host.accepted();
}

function tellValue(field) {
    const control = field.control;
    if (control.tagName === "SELECT") {
        if (control.selectedIndex === field.choice) return;
        field.choice = control.selectedIndex;
        host.filled(field.index, control.value, field.choice, false);
        return;
    }
    const isUnreadable = Boolean(control.validity && control.validity.badInput);
    if (control.value === field.value && isUnreadable === field.isUnreadable) return;
    field.value = control.value;
    field.isUnreadable = isUnreadable;
    host.filled(field.index, field.value, -1, isUnreadable);
    if (field.isText) showInNamesakes(field);
}

// In the frame of the letter itself: what the program answers says the same.
function showInNamesakes(field) {
    for (const other of namesakes.get(field.control.name) || []) {
        if (other === field) continue;
        other.value = field.value;
        other.control.value = field.value;
    }
}

function measure() {
    const style = document.body.style;
    document.body.classList.add("measured");
    const wanted = Math.ceil(document.body.getBoundingClientRect().width);
    const width = Math.min(640, Math.max(420, wanted), screen.availWidth - 8);
    style.width = width + "px";
    const height = Math.ceil(document.body.getBoundingClientRect().height);
    document.body.classList.remove("measured");
    style.width = "";
    host.measured(width, height);
}

// ---- From the program ----

function update(changes) {
    for (const change of changes.fields) {
        const field = fields.get(change.index);
        if (field) showField(field, change);
    }
    document.body.classList.remove("waiting");
    if ("length" in changes) document.getElementById("length").textContent = changes.length;
    if (!isShown) measure();
}

function showField(field, change) {
    if ("value" in change) {
        field.wanted = change.value;
        if (field !== edited) showWanted(field);
    }
    if ("choice" in change && field.control.tagName === "SELECT") {
        field.choice = change.choice;
        if (field.control.selectedIndex !== change.choice) field.control.selectedIndex = change.choice;
    }
    if ("selected" in change && field.box) {
        field.box.checked = change.selected;
        showSelected(field);
    }
    if ("problem" in change) showProblem(field, change.problem);
}

function showWanted(field) {
    const { control, wanted } = field;
    if (wanted === null) return;
    field.wanted = null;
    field.value = wanted;
    if (control.tagName === "SPAN") {
        control.textContent = wanted;
    } else if (control.value !== wanted) {
        control.value = wanted;
        if (control === document.activeElement && control.tagName === "INPUT") control.select();
    }
}

function showSelected(field) {
    if (!field.part) return;
    field.part.classList.toggle("used", field.box.checked);
    field.part.classList.toggle("unused", !field.box.checked);
}

function showProblem(field, problem) {
    if (!field.problem) {
        if (problem === "") return;
        field.problem = document.createElement("span");
        field.problem.className = "problem";
        field.problem.id = "problem" + field.index;
        field.problem.setAttribute("role", "status");
        (field.part || field.control).after(field.problem);
        field.control.setAttribute("aria-describedby", field.problem.id);
    }
    field.problem.textContent = problem;
    field.control.setAttribute("aria-invalid", String(problem !== ""));
}

// Tells when what stands there now has been drawn.
function appear() {
    isShown = true;
    if (document.activeElement === document.body) focusFirst();
    requestAnimationFrame(() => requestAnimationFrame(() => host.drawn()));
}

// ---- Keys ----

function stops() {
    return Array.from(document.querySelectorAll("main input, main select, main textarea"));
}

function focus(stop) {
    stop.focus();
    if (stop.tagName === "INPUT" && stop.type !== "checkbox") stop.select();
    stop.scrollIntoView({ block: "nearest" });
}

function focusFirst() {
    const first = stops().find((stop) => stop.type !== "checkbox") || stops()[0];
    if (first) focus(first);
}

function walk(direction) {
    const all = stops();
    if (all.length === 0) return;
    const at = all.indexOf(document.activeElement);
    const next = at < 0 ? (direction > 0 ? 0 : all.length - 1) : at + direction;
    focus(all[(next + all.length) % all.length]);
}

function tick(box) {
    box.click();
    box.focus();
}

function isComposing(event) {
    return event.isComposing || event.keyCode === 229;
}

// What a key with Alt is called, whether its digit stands in the upper row or behind Shift there.
function boxOf(event) {
    if (!event.altKey || event.ctrlKey || event.metaKey) return undefined;
    const digit = /^(?:Digit|Numpad)([1-9])$/.exec(event.code);
    return letters.get(event.key.toUpperCase()) || (digit ? letters.get(digit[1]) : undefined);
}

function takesKey(event) {
    if (event.key === "Escape") {
        host.cancelled();
    } else if (event.key === "Enter" && event.ctrlKey) {
        if (!event.repeat) accept();
    } else if (event.key === "Tab" && !event.ctrlKey && !event.altKey && !event.metaKey) {
        walk(event.shiftKey ? -1 : 1);
    } else if (event.key === "Enter" && event.target.tagName === "SELECT") {
        // Without this it would open; Return that closes it is not heard here.
        armed = event.target;
    } else {
        const box = boxOf(event);
        if (!box) return false;
        tick(box);
    }
    return true;
}

// Return that is for what has the focus, or for an input method.
function keepsReturn(event) {
    const target = event.target;
    return isComposing(event) || target.tagName !== "INPUT" || target.type === "checkbox";
}

document.addEventListener("keydown", (event) => {
    armed = null;
    if (event.key === "Enter" && !event.ctrlKey && keepsReturn(event)) host.stayed();
    if (isComposing(event) || !takesKey(event)) return;
    event.preventDefault();
    event.stopPropagation();
}, true);

// ---- Doings of the user ----

function fieldOf(element) {
    return element.id ? fields.get(Number(element.id)) : undefined;
}

document.addEventListener("input", (event) => {
    const field = fieldOf(event.target);
    if (!field) return;
    if (event.target.tagName !== "SELECT") edited = field;
    tellValue(field);
}, true);

function leave(field) {
    if (!field) return;
    tellValue(field);
    if (field === edited) edited = null;
    showWanted(field);
}

document.addEventListener("change", (event) => leave(fieldOf(event.target)), true);
document.addEventListener("focusout", (event) => leave(fieldOf(event.target)), true);
// Links lead nowhere, by no button.
for (const kind of ["click", "auxclick"]) {
    document.addEventListener(kind, (event) => {
        if (event.target.closest("a")) event.preventDefault();
    }, true);
}

// ---- The page when it has come ----

function giveLetter(label, box) {
    const name = label.textContent;
    const noKey = /[\p{Script=Han}\p{Script=Hangul}\p{Script=Hiragana}\p{Script=Katakana}]/u;
    for (let at = 0; at < name.length; ++at) {
        const letter = name[at].toUpperCase();
        if (!/\p{L}/u.test(name[at]) || noKey.test(name[at]) || letters.has(letter)) continue;
        const mark = document.createElement("u");
        mark.textContent = name[at];
        label.replaceChildren(name.slice(0, at), mark, name.slice(at + 1));
        return setLetter(letter, box);
    }
    for (let digit = 1; digit <= 9; ++digit) {
        if (letters.has(String(digit))) continue;
        const mark = document.createElement("u");
        mark.textContent = String(digit);
        label.replaceChildren(name.trimEnd() + " (", mark, ")");
        return setLetter(String(digit), box);
    }
}

function setLetter(letter, box) {
    letters.set(letter, box);
    box.setAttribute("aria-keyshortcuts", "Alt+" + letter);
}

function addField(control) {
    const index = Number(control.id);
    const box = document.getElementById("optional" + index);
    const isText = control.tagName === "TEXTAREA" || control.type === "text";
    const field = { index, control, isText, box, part: box ? control.parentElement : null, problem: null, wanted: null,
                    value: control.tagName === "SPAN" ? control.textContent : control.value, isUnreadable: false,
                    choice: control.tagName === "SELECT" ? control.selectedIndex : -1 };
    fields.set(index, field);
    if (isText && control.name) {
        if (!namesakes.has(control.name)) namesakes.set(control.name, []);
        namesakes.get(control.name).push(field);
    }
    if (control.tagName !== "SPAN") {
        control.setAttribute("aria-label", control.getAttribute("name") || document.title);
        control.setAttribute("autocomplete", "off");
    }
    // Browsers give numbers all the width that any number could need; the buttons need some too.
    if (control.type === "number") control.style.width = "calc(12ch + 2.5em)";
    if (!box) return;
    field.part.classList.add("optional");
    showSelected(field);
    const label = document.querySelector(`label[for="${box.id}"]`);
    if (!label) return;
    label.textContent = label.textContent.trim();
    // No line ends between the two.
    const pair = document.createElement("span");
    pair.className = "pair";
    box.before(pair);
    pair.append(box, " ", label);
    box.setAttribute("aria-label", label.textContent || document.title);
    giveLetter(label, box);
}

function onLoad() {
    for (const control of document.querySelectorAll("main [id]")) {
        if (/^\d+$/.test(control.id)) addField(control);
    }
    for (const link of document.querySelectorAll("main a")) link.removeAttribute("href");
    isLoaded = true;
    begin();
}

function begin() {
    if (!isLoaded || !host) return;
    setButtons();
    host.linked();
}

// At once, so that the program is there when the page is.
new QWebChannel(qt.webChannelTransport, (channel) => {
    host = channel.objects.form;
    host.updated.connect(update);
    host.appears.connect(appear);
    host.coloured.connect((colours) => { document.getElementById("colours").textContent = colours; });
    begin();
});

function setButtons() {
    // Keys do the same from anywhere, and Tab is for fields.
    for (const [id, act] of [["insert", accept], ["cancel", () => host.cancelled()]]) {
        const button = document.getElementById(id);
        button.tabIndex = -1;
        button.addEventListener("mousedown", (event) => event.preventDefault());
        button.addEventListener("click", act);
    }
}

document.addEventListener("DOMContentLoaded", () => window.SnippetController.onBodyOnLoad());

function put(name, value) {
    Object.defineProperty(window, name, { value, writable: false, configurable: false });
}

// Return in what has one line. A menu's key comes up here after the menu has closed too.
put("handleKeyUpEvent", (event) => {
    if (event.key !== "Enter" || isComposing(event) || event.shiftKey || event.altKey || event.metaKey) return true;
    if (event.type === "keyup" && armed !== event.target) return true;
    armed = null;
    if (!event.repeat) accept();
    return false;
});
// Return in what has several lines is one more; with Control it has been heard before.
put("handleKeyUpEventAlt", () => true);
put("optionalFieldCheckboxOnChange", (event) => {
    const field = fields.get(Number(event.target.id.replace("optional", "")));
    if (!field) return;
    showSelected(field);
    host.selected(field.index, event.target.checked);
});
put("SnippetController", Object.freeze({
    onBodyOnLoad: onLoad,
    onTextInputKeyUp_(id) {
        const field = fields.get(Number(id));
        if (field) tellValue(field);
    },
    onTextInputOnChange_(id) {
        const field = fields.get(Number(id));
        if (field) tellValue(field);
    },
    acceptFields_() { accept(); },
    cancel_() { host.cancelled(); },
}));
