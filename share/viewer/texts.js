// What the page says, in the first of the reader's languages that it has.

const RECORDING = JSON.parse(document.getElementById('recording').textContent);
const ALL_TEXTS = JSON.parse(document.getElementById('texts').textContent);
const LANGUAGE = chosenLanguage(navigator.languages);
const ENGLISH = ALL_TEXTS.en;

function chosenLanguage(wanted) {
    for (const language of wanted) {
        const base = language.toLowerCase().split('-')[0];
        if (base in ALL_TEXTS) return base;
    }
    return 'en';
}

// The text of a key, with %1, %2, ... replaced by the values.
function say(key, ...values) {
    const text = ALL_TEXTS[LANGUAGE][key] ?? ENGLISH[key];
    return text.replace(/%(\d)/g, (_, place) => values[Number(place) - 1]);
}

function element(id) {
    return document.getElementById(id);
}

// A button is named twice: for the eye that waits over it, and for the ear.
function label(control, text) {
    control.setAttribute('aria-label', text);
    control.title = text;
}

function showTexts() {
    document.documentElement.lang = LANGUAGE;
    for (const place of document.querySelectorAll('[data-text]'))
        place.textContent = say(place.dataset.text);
}
