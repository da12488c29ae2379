// A ring with smooth edges, in units of the square that it is drawn on.
const float c_Radius = 0.2;
const float c_Border = 0.1;
const float c_Smooth = 0.02;

uniform vec4 u_ModelColour;

varying vec2 v_UV;

void main()
{
	float fromRing = abs(length(v_UV - 0.5) - c_Radius) - 0.5 * c_Border;
	float ring = 1.0 - smoothstep(-c_Smooth, c_Smooth, fromRing);
	gl_FragColor = vec4(u_ModelColour.rgb, u_ModelColour.a * ring);
}
