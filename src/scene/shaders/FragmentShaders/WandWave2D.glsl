// The trail of a wand, which fades with its age.
uniform vec4 u_ModelColour;

varying float v_Age;

void main()
{
	gl_FragColor = vec4(u_ModelColour.rgb, u_ModelColour.a * clamp(1.0 - v_Age, 0.0, 1.0));
}
